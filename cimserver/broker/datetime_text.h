// The 25-character text of a CIM datetime (DSP0004, "Datetime type") and its binary form in CMPI: microseconds, since
// 1970-01-01 UTC for a timestamp, or the length of an interval.
//
//     yyyymmddhhmmss.mmmmmmsutc    timestamp; s is + or -, utc minutes
//     ddddddddhhmmss.mmmmmm:000    interval
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace cimserver
{

struct Datetime_Value
{
    std::uint64_t microseconds; // 0 for a timestamp before 1970, or one with a field left open
    bool interval;
};

// Reads a text; nothing when it is not a datetime. Fields left open ("*") are accepted.
std::optional<Datetime_Value> parse_datetime(std::string_view text);

// The text of a binary value, timestamps in UTC; nothing when the value does not fit the form.
std::optional<std::string> format_datetime(const Datetime_Value& value);

} // namespace cimserver
