// The 25-character text of a CIM datetime (DSP0004, "Datetime type").
//
//     yyyymmddhhmmss.mmmmmmsutc    timestamp; s is + or -, utc minutes
//     ddddddddhhmmss.mmmmmm:000    interval
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string_view>

namespace text
{

inline constexpr std::size_t datetime_size = 25;

struct Datetime_Fields
{
    bool interval = false;
    std::uint32_t year = 0; // of a timestamp, and so the month
    std::uint32_t month = 0;
    std::uint32_t day = 0; // of the month, or the days of an interval
    std::uint32_t hour = 0;
    std::uint32_t minute = 0;
    std::uint32_t second = 0;
    std::uint32_t microsecond = 0;
    std::int32_t offset = 0; // minutes that a timestamp is ahead of UTC
};

// The fields of a text in one of the two forms, whatever numbers they are (a 25th hour too); else nothing.
std::optional<Datetime_Fields> read_datetime(std::string_view text);

// Writes the text, or one with separators for people ("2024/02/29 23:59:59.123456+060", "00000001 02 03 04.000005:000"), without
// a terminator, and returns its end. Of a number with more digits than its field the last ones stand.
char* write_datetime(const Datetime_Fields& fields, char* out, bool for_people = false);

} // namespace text
