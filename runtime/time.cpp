#include "runtime/time.h"

#include <cerrno>
#include <sys/select.h>
#include <sys/time.h>

namespace zmlr
{

uint64 Time::now()
{
    timeval time{};
    gettimeofday(&time, nullptr);
    return static_cast<uint64>(time.tv_sec) * SEC + static_cast<uint64>(time.tv_usec);
}

void Time::sleep(uint64 usec)
{
    // Linux leaves what remains of an interrupted wait in the timeout.
    timeval timeout{static_cast<time_t>(usec / SEC), static_cast<suseconds_t>(usec % SEC)};
    while (select(0, nullptr, nullptr, nullptr, &timeout) != 0 && errno == EINTR)
        continue;
}

} // namespace zmlr
