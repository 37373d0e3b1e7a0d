// The shell around everything that a CIM server calls: no exception leaves the module.
#pragma once

#include <cmpidt.h>

namespace zmlr
{

// Logs at LL_ERR what the exception being handled says about the function `name`.
void log_exception(const char* name) noexcept;

// The answer of `work`, a CMPIrc, or CMPI_RC_ERR_FAILED and a log line when it throws.
template <class Work> CMPIrc shielded(const char* name, Work&& work) noexcept
{
    try
    {
        return work();
    }
    catch (...)
    {
        log_exception(name);
        return CMPI_RC_ERR_FAILED;
    }
}

} // namespace zmlr
