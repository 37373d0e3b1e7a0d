// Where the library meets the end of memory: an exception must not reach a C caller.
#pragma once

#include "hxal/records/status.h"

#include <new>

namespace hxal
{

// What `work` returns; HXA_STATUS_ENOMEM when it runs out of memory.
template <typename Work> hxa_status_t within_memory(Work work) noexcept
{
    try
    {
        return work();
    }
    catch (const std::bad_alloc&)
    {
        return HXA_STATUS_ENOMEM;
    }
}

} // namespace hxal
