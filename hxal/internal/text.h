// Texts in fixed fields. A field from a driver may lack its terminator; a field of a handle never does.
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstring>

namespace hxal
{

// Copies a driver's text into a field of ours, cut where it does not fit, and fills the rest with zeros.
template <std::size_t To, std::size_t From> void copy_text(char (&to)[To], const char (&from)[From])
{
    const std::size_t length = std::min(::strnlen(from, From), To - 1);
    std::memcpy(to, from, length);
    std::memset(to + length, 0, To - length);
}

// Whether a caller's text, which may be missing, is the text of a field. A full field may have been cut: what the caller has
// beyond it does not count.
template <std::size_t Size> bool same_text(const char* wanted, const char (&field)[Size])
{
    return wanted && std::strncmp(wanted, field, Size - 1) == 0;
}

// Copies a terminated text into a caller's buffer, which may be missing.
inline void copy_out(char* buffer, const char* field)
{
    if (buffer)
        std::memcpy(buffer, field, std::strlen(field) + 1);
}

} // namespace hxal
