#include "cimserver/broker/datetime_text.h"

#include <algorithm>
#include <array>
#include <chrono>
#include <cstdio>

namespace cimserver
{
namespace
{

namespace chrono = std::chrono;

constexpr std::size_t text_size = 25;
constexpr std::size_t point = 14;
constexpr std::size_t sign = 21;
constexpr std::uint64_t second = 1'000'000; // in microseconds
constexpr std::uint64_t day = 86'400 * second;
constexpr std::uint64_t max_interval_days = 99'999'999;
constexpr std::uint64_t max_timestamp_days = 2'932'896; // 9999-12-31

bool is_digit_or_open(char c) { return (c >= '0' && c <= '9') || c == '*'; }

bool well_formed(std::string_view text)
{
    if (text.size() != text_size || text[point] != '.')
        return false;
    if (text[sign] != ':' && text[sign] != '+' && text[sign] != '-')
        return false;
    for (std::size_t i = 0; i < text_size; ++i)
        if (i != point && i != sign && !is_digit_or_open(text[i]))
            return false;
    return true;
}

unsigned number(std::string_view text, std::size_t start, std::size_t length)
{
    unsigned result = 0;
    for (const char c : text.substr(start, length))
        result = result * 10 + static_cast<unsigned>(c - '0');
    return result;
}

std::uint64_t time_of_day(std::string_view text)
{
    const std::uint64_t seconds = number(text, 8, 2) * 3600ULL + number(text, 10, 2) * 60ULL + number(text, 12, 2);
    return seconds * second + number(text, 15, 6);
}

bool valid_time_of_day(std::string_view text)
{
    return number(text, 8, 2) < 24 && number(text, 10, 2) < 60 && number(text, 12, 2) < 60;
}

std::uint64_t timestamp(std::string_view text, chrono::year_month_day date)
{
    const auto days = chrono::sys_days(date).time_since_epoch().count();
    const auto offset = static_cast<std::int64_t>(number(text, 22, 3)) * (text[sign] == '-' ? -60 : 60);
    const auto local =
        static_cast<std::int64_t>(days) * static_cast<std::int64_t>(day) + static_cast<std::int64_t>(time_of_day(text));
    return static_cast<std::uint64_t>(std::max<std::int64_t>(0, local - offset * static_cast<std::int64_t>(second)));
}

} // namespace

std::optional<Datetime_Value> parse_datetime(std::string_view text)
{
    if (!well_formed(text))
        return std::nullopt;

    const bool interval = text[sign] == ':';
    if (text.find('*') != std::string_view::npos)
        return Datetime_Value{0, interval};
    if (!valid_time_of_day(text))
        return std::nullopt;
    if (interval)
        return Datetime_Value{number(text, 0, 8) * day + time_of_day(text), true};

    const chrono::year_month_day date(chrono::year(static_cast<int>(number(text, 0, 4))), chrono::month(number(text, 4, 2)),
                                      chrono::day(number(text, 6, 2)));
    // A timestamp of all zeros is what many agents answer for an unset clock: no date, yet in the form.
    return Datetime_Value{date.ok() ? timestamp(text, date) : 0, false};
}

std::optional<std::string> format_datetime(const Datetime_Value& value)
{
    const std::uint64_t days = value.microseconds / day;
    if (days > (value.interval ? max_interval_days : max_timestamp_days))
        return std::nullopt;

    std::array<char, 16> date{};
    if (value.interval)
        std::snprintf(date.data(), date.size(), "%08u", static_cast<unsigned>(days));
    else
    {
        const chrono::year_month_day ymd(chrono::sys_days(chrono::days(static_cast<int>(days))));
        std::snprintf(date.data(), date.size(), "%04d%02u%02u", static_cast<int>(ymd.year()), static_cast<unsigned>(ymd.month()),
                      static_cast<unsigned>(ymd.day()));
    }

    const auto seconds = static_cast<unsigned>(value.microseconds % day / second);
    std::array<char, 40> text{};
    std::snprintf(text.data(), text.size(), "%s%02u%02u%02u.%06u%s", date.data(), seconds / 3600, seconds / 60 % 60, seconds % 60,
                  static_cast<unsigned>(value.microseconds % second), value.interval ? ":000" : "+000");
    return std::string(text.data(), text_size);
}

} // namespace cimserver
