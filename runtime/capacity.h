// How growable storage of the runtime sizes itself.
#pragma once

#include "runtime/types.h"

#include <algorithm>
#include <bit>
#include <cstddef>
#include <new>

namespace zmlr
{

// The next power of two not below n and not below `least` (itself a power of two). Throws std::bad_array_new_length when
// n is above 2^31.
inline uint32 _next_pow_2(std::size_t n, uint32 least)
{
    if (n > 0x80000000U)
        throw std::bad_array_new_length();
    return std::max(least, std::bit_ceil(static_cast<uint32>(n)));
}

} // namespace zmlr
