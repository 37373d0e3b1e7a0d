// Texts in fixed fields. A field from a driver may lack its terminator; a field of a handle never does.
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstring>

namespace hxal
{

// Fills a field with the first characters of a text, which may be its own, and zeros behind them.
template <std::size_t To> void fill_text(char (&to)[To], const char* from, std::size_t length)
{
    std::memmove(to, from, length);
    std::memset(to + length, 0, To - length);
}

// Copies a driver's text into a field of ours, cut to leave room for the terminator.
template <std::size_t To, std::size_t From> void copy_text(char (&to)[To], const char (&from)[From])
{
    fill_text(to, from, std::min(::strnlen(from, From), To - 1));
}

// Copies a caller's text into a field of ours, cut to leave room for the terminator.
template <std::size_t To> void keep_text(char (&to)[To], const char* from) { fill_text(to, from, ::strnlen(from, To - 1)); }

// Copies a caller's text into a field of a driver's record, which needs no terminator: only what does not fit is cut.
template <std::size_t To> void put_text(char (&to)[To], const char* from) { fill_text(to, from, ::strnlen(from, To)); }

// Whether a caller's text, which may be missing, is the text of a field. A full field may have been cut: what the caller has
// beyond it does not count.
template <std::size_t Size> bool same_text(const char* wanted, const char (&field)[Size])
{
    return wanted && std::strncmp(wanted, field, Size - 1) == 0;
}

// A serial number has 12 characters at most. Handles and adapters keep it terminated; a record, an entry of the configuration and
// a caller's buffer have room for the characters alone.
constexpr std::size_t serial_size = 12;

inline bool same_serial(const char* wanted, const char (&field)[serial_size])
{
    return wanted && std::strncmp(wanted, field, serial_size) == 0;
}

inline void copy_serial_out(char* buffer, const char (&serial)[serial_size + 1])
{
    if (buffer)
        std::memcpy(buffer, serial, std::min(std::strlen(serial) + 1, serial_size));
}

// Copies a terminated text into a caller's buffer, which may be missing.
inline void copy_out(char* buffer, const char* field)
{
    if (buffer)
        std::memcpy(buffer, field, std::strlen(field) + 1);
}

} // namespace hxal
