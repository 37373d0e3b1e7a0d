#include "cimserver/cimxml/value_text.h"

#include "runtime/types.h"

#include <charconv>
#include <chrono>
#include <cmath>
#include <limits>
#include <utility>

namespace cimserver
{

namespace
{

struct Type_Row
{
    CMPIType type;
    const char* name;
};

// The first rows in the order of zmlr::Type.
constexpr Type_Row types[] = {
    {CMPI_boolean, "boolean"}, {CMPI_uint8, "uint8"},       {CMPI_sint8, "sint8"},   {CMPI_uint16, "uint16"},
    {CMPI_sint16, "sint16"},   {CMPI_uint32, "uint32"},     {CMPI_sint32, "sint32"}, {CMPI_uint64, "uint64"},
    {CMPI_sint64, "sint64"},   {CMPI_real32, "real32"},     {CMPI_real64, "real64"}, {CMPI_char16, "char16"},
    {CMPI_string, "string"},   {CMPI_dateTime, "datetime"}, {CMPI_chars, "string"},  {CMPI_ref, "reference"},
    {CMPI_instance, "string"},
};

template <class T> std::string digits(T number)
{
    char buffer[32];
    return std::string(buffer, std::to_chars(buffer, buffer + sizeof buffer, number).ptr);
}

std::optional<std::uint64_t> largest(CMPIType type)
{
    switch (type)
    {
    case CMPI_uint8:
        return std::numeric_limits<std::uint8_t>::max();
    case CMPI_uint16:
        return std::numeric_limits<std::uint16_t>::max();
    case CMPI_uint32:
        return std::numeric_limits<std::uint32_t>::max();
    case CMPI_uint64:
        return std::numeric_limits<std::uint64_t>::max();
    case CMPI_sint8:
        return std::numeric_limits<std::int8_t>::max();
    case CMPI_sint16:
        return std::numeric_limits<std::int16_t>::max();
    case CMPI_sint32:
        return std::numeric_limits<std::int32_t>::max();
    case CMPI_sint64:
        return std::numeric_limits<std::int64_t>::max();
    default:
        return std::nullopt;
    }
}

bool is_signed(CMPIType type) { return (type & 0x40) != 0; }

template <class Integer> std::optional<std::string> integer_text(CMPIType type, Integer number)
{
    const auto limit = largest(type);
    if (!limit || std::cmp_greater(number, *limit))
        return std::nullopt;
    if (number < 0 && !(is_signed(type) && std::cmp_greater_equal(number, -static_cast<std::int64_t>(*limit) - 1)))
        return std::nullopt;
    return digits(number);
}

// One UTF-16 code unit as UTF-8: half of a surrogate pair is no character, and neither is a control character.
std::optional<std::string> char16_text(std::uint64_t code)
{
    if (code < 0x20 || code > 0xFFFD || (code >= 0xD800 && code <= 0xDFFF))
        return std::nullopt;
    const auto byte = [](std::uint64_t bits) { return static_cast<char>(static_cast<unsigned char>(bits)); };
    if (code < 0x80)
        return std::string{byte(code)};
    if (code < 0x800)
        return std::string{byte(0xC0 | code >> 6), byte(0x80 | (code & 0x3F))};
    return std::string{byte(0xE0 | code >> 12), byte(0x80 | (code >> 6 & 0x3F)), byte(0x80 | (code & 0x3F))};
}

// The shortest text that reads back as the same number, with the point and the digit behind it that DSP0201 asks for.
std::string real_text(CMPIType type, double number)
{
    if (std::isnan(number))
        return "NaN";
    if (std::isinf(number))
        return number < 0 ? "-INF" : "INF";
    std::string text = type == CMPI_real32 ? digits(static_cast<float>(number)) : digits(number);
    if (text.find('.') == std::string::npos)
        text.insert(std::min(text.find('e'), text.size()), ".0");
    return text;
}

std::optional<std::string> string_text(CMPIType type, const std::string& text)
{
    if (type == CMPI_dateTime && !is_readable_datetime(text))
        return std::nullopt;
    return text;
}

// The number that `size` digits at `pos` write, -1 when one is no digit.
int number_at(const std::string& text, std::size_t pos, std::size_t size)
{
    int number = 0;
    for (std::size_t i = pos; i < pos + size; ++i)
    {
        if (text[i] < '0' || text[i] > '9')
            return -1;
        number = number * 10 + (text[i] - '0');
    }
    return number;
}

bool in_range(int number, int first, int last) { return number >= first && number <= last; }

bool is_calendar_day(int year, int month, int day)
{
    return year >= 1 && month >= 1 && day >= 1 &&
           std::chrono::year_month_day(std::chrono::year(year), std::chrono::month(static_cast<unsigned>(month)),
                                       std::chrono::day(static_cast<unsigned>(day)))
               .ok();
}

} // namespace

std::string_view trimmed(std::string_view text)
{
    constexpr std::string_view blanks = " \t\r\n";
    const std::size_t first = text.find_first_not_of(blanks);
    return first == std::string_view::npos ? std::string_view() : text.substr(first, text.find_last_not_of(blanks) - first + 1);
}

const char* cim_type_name(CMPIType type)
{
    const CMPIType element = type & static_cast<CMPIType>(~CMPI_ARRAY);
    for (const Type_Row& row : types)
        if (row.type == element)
            return row.name;
    return nullptr;
}

CMPIType cmpi_type(unsigned type) { return type < zmlr::num_types ? types[type].type : static_cast<CMPIType>(CMPI_null); }

std::optional<std::string> value_text(const Value& value)
{
    if (const auto* flag = std::get_if<bool>(&value.content))
        return *flag ? "true" : "false";
    if (const auto* number = std::get_if<std::uint64_t>(&value.content))
        return value.type == CMPI_char16 ? char16_text(*number) : integer_text(value.type, *number);
    if (const auto* number = std::get_if<std::int64_t>(&value.content))
        return integer_text(value.type, *number);
    if (const auto* number = std::get_if<double>(&value.content))
        return real_text(value.type, *number);
    if (const auto* text = std::get_if<std::string>(&value.content))
        return string_text(value.type, *text);
    return std::nullopt;
}

bool is_readable_datetime(const std::string& text)
{
    if (text.size() != 25 || text[14] != '.' || number_at(text, 15, 6) < 0 || !in_range(number_at(text, 8, 2), 0, 23) ||
        !in_range(number_at(text, 10, 2), 0, 59) || !in_range(number_at(text, 12, 2), 0, 59))
        return false;
    if (text[21] == ':')
        return number_at(text, 0, 8) >= 0 && number_at(text, 22, 3) == 0;
    return (text[21] == '+' || text[21] == '-') && in_range(number_at(text, 22, 3), 0, 999) &&
           is_calendar_day(number_at(text, 0, 4), number_at(text, 4, 2), number_at(text, 6, 2));
}

} // namespace cimserver
