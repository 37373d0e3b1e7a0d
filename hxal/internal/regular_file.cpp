#include "hxal/internal/regular_file.h"

#include <cstdio>

namespace hxal
{

Regular_File::Regular_File(const char* path) : _place(path, O_PATH)
{
    if (!exists() || ::fstat(_place.number(), &_status) != 0 || !S_ISREG(_status.st_mode))
        return;
    // The path may lead elsewhere by now; this one leads to what was looked at.
    char same[32];
    std::snprintf(same, sizeof same, "/proc/self/fd/%d", _place.number());
    _file.emplace(same, O_RDONLY | O_NONBLOCK | O_NOCTTY);
}

} // namespace hxal
