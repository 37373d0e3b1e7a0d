// Buffers that a record refers to.
#pragma once

#include <cstdint>

namespace hxal
{

// A buffer's address as it stands in a record: 8 bytes on every host.
inline uint64_t sender_address(const void* buffer) { return reinterpret_cast<std::uintptr_t>(buffer); }

} // namespace hxal
