#include "cimserver/model/value_text.h"

#include "text/characters.h"
#include "text/datetime.h"
#include "text/integers.h"

#include <charconv>
#include <chrono>
#include <cmath>

namespace cimserver
{
namespace
{

namespace chrono = std::chrono;

template <class T> std::string digits(T number)
{
    char buffer[32];
    return std::string(buffer, std::to_chars(buffer, buffer + sizeof buffer, number).ptr);
}

// One UTF-16 code unit as UTF-8: half of a surrogate pair is no character, and neither is a control character.
std::optional<std::string> char16_text(std::uint64_t code)
{
    if (code < 0x20 || code > 0xFFFD || (code >= 0xD800 && code <= 0xDFFF))
        return std::nullopt;
    return text::utf8_of(static_cast<char16_t>(code));
}

template <class Number> std::optional<std::string> integer_text(const Cim_Type& type, Number number)
{
    const bool negative = number < 0;
    const auto bits = static_cast<std::uint64_t>(number);
    if (type.bits == 0 || !text::fits({negative, negative ? 0 - bits : bits}, type.bits, type.is_signed))
        return std::nullopt;
    return type.code == CMPI_char16 ? char16_text(bits) : digits(number);
}

// The shortest text that reads back as the same number, with the point and the digit behind it that DSP0201 asks for.
std::string real_text(CMPIType type, double number)
{
    if (std::isnan(number))
        return "NaN";
    if (std::isinf(number))
        return number < 0 ? "-INF" : "INF";
    std::string result = type == CMPI_real32 ? digits(static_cast<float>(number)) : digits(number);
    if (result.find('.') == std::string::npos)
        result.insert(std::min(result.find('e'), result.size()), ".0");
    return result;
}

chrono::year_month_day date_of(const text::Datetime_Fields& fields)
{
    return {chrono::year(static_cast<int>(fields.year)), chrono::month(fields.month), chrono::day(fields.day)};
}

} // namespace

std::optional<std::string> value_text(const Value& value)
{
    const Cim_Type* type = find_type(value.type);
    if (!type)
        return std::nullopt;
    if (const auto* flag = value.as<bool>())
        return *flag ? "true" : "false";
    if (const auto* number = value.as<std::uint64_t>())
        return integer_text(*type, *number);
    if (const auto* number = value.as<std::int64_t>())
        return integer_text(*type, *number);
    if (const auto* number = value.as<double>())
        return real_text(value.type, *number);
    if (const auto* string = value.as<Text>())
        if (value.type != CMPI_dateTime || is_readable_datetime(*string))
            return *string;
    return std::nullopt;
}

bool is_readable_datetime(std::string_view text)
{
    const auto fields = text::read_datetime(text);
    if (!fields || fields->hour > 23 || fields->minute > 59 || fields->second > 59)
        return false;
    return fields->interval || (fields->year >= 1 && date_of(*fields).ok());
}

} // namespace cimserver
