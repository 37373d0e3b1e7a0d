// Character classes of ASCII, whatever the process's locale: how names, digits and white space are read.
#pragma once

#include "runtime/types.h"

#include <array>

namespace zmlr::ascii
{

constexpr std::array<unsigned char, 256> make_lower_table()
{
    std::array<unsigned char, 256> table{};
    for (unsigned i = 0; i < table.size(); ++i)
        table[i] = static_cast<unsigned char>(i >= 'A' && i <= 'Z' ? i - 'A' + 'a' : i);
    return table;
}

inline constexpr std::array<unsigned char, 256> lower_table = make_lower_table();

constexpr unsigned char to_lower(char c) { return lower_table[static_cast<unsigned char>(c)]; }
constexpr bool is_digit(char c) { return c >= '0' && c <= '9'; }
constexpr bool is_space(char c) { return c == ' ' || (c >= '\t' && c <= '\r'); }

} // namespace zmlr::ascii
