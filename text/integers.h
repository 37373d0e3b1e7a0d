// Integers in texts, independent of the process's locale.
#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

namespace text
{

// The number that digits of base 10 or 16 (letters of either case) write. Nothing when there are none, something else stands
// among them, or 64 bits cannot hold it.
std::optional<std::uint64_t> read_digits(std::string_view digits, int base);

struct Integer
{
    bool negative = false;
    std::uint64_t magnitude = 0;
};

// A whole text: a sign or none, then decimal digits, or hexadecimal ones after "0x" or "0X".
std::optional<Integer> read_integer(std::string_view text);

// Whether an integer type of 8, 16, 32 or 64 bits can hold the number.
bool fits(const Integer& number, unsigned bits, bool is_signed);

} // namespace text
