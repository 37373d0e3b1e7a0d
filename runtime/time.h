// Time: the clock and pauses, in microseconds.
#pragma once

#include "runtime/types.h"

namespace zmlr
{

struct Time
{
    static constexpr uint64 USEC = 1;
    static constexpr uint64 MSEC = 1000;
    static constexpr uint64 SEC = 1000000;

    static uint64 now(); // microseconds since 1970-01-01 UTC

    // Returns when at least that long has passed; signals that the thread handles meanwhile do not shorten it.
    static void sleep(uint64 usec);
};

} // namespace zmlr
