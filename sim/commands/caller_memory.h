// The caller's record, reached as a kernel reaches user memory: a bad address is an answer (false), not a crash.
#pragma once

#include <cstdint>
#include <span>

namespace hxasim
{

// A buffer of the caller's, as a record refers to it.
inline void* address_of(std::uint64_t pointer) { return reinterpret_cast<void*>(static_cast<std::uintptr_t>(pointer)); }

bool copy_from_caller(std::span<std::uint8_t> to, const void* from);
bool copy_to_caller(void* to, std::span<const std::uint8_t> from);

} // namespace hxasim
