// Entry and exit lines at LL_DBG: what every manager, helper and utility function writes.
#pragma once

#include "runtime/log.h"

namespace zmlr
{

// Logs "Entering: name" when made and "Returning: name" when its scope is left by any way.
class Scope_Trace
{
public:
    explicit Scope_Trace(const char* file, const char* name = __builtin_FUNCTION(), int line = __builtin_LINE())
        : _file(file)
        , _name(name)
        , _line(line)
    {
        if (log_wanted(LL_DBG))
            log(LL_DBG, _file, _line, "Entering: %s", _name);
    }

    ~Scope_Trace()
    {
        if (log_wanted(LL_DBG))
            log(LL_DBG, _file, _line, "Returning: %s", _name);
    }

    Scope_Trace(const Scope_Trace&) = delete;
    Scope_Trace& operator=(const Scope_Trace&) = delete;

private:
    const char* _file;
    const char* _name;
    int _line;
};

} // namespace zmlr
