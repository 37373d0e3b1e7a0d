#include "cimserver/model/value_reader.h"

#include "cimserver/model/names.h"
#include "cimserver/model/value_text.h"
#include "text/characters.h"
#include "text/integers.h"

#include <charconv>
#include <cmath>

namespace cimserver
{
namespace
{

std::optional<text::Integer> integer_of(const Value& value)
{
    if (const auto* number = value.as<std::uint64_t>())
        return text::Integer{false, *number};
    if (const auto* number = value.as<std::int64_t>())
        return text::Integer{*number < 0,
                             *number < 0 ? 0 - static_cast<std::uint64_t>(*number) : static_cast<std::uint64_t>(*number)};
    if (const auto* string = value.as<Text>())
        return text::read_integer(trimmed(*string));
    return std::nullopt;
}

// Null also for a number that the type cannot hold.
Value::Content integer_content(const Value& value, const Cim_Type& type)
{
    const auto number = integer_of(value);
    if (!number || !text::fits(*number, type.bits, type.is_signed))
        return {};
    if (!type.is_signed)
        return number->magnitude;
    return static_cast<std::int64_t>(number->negative ? 0 - number->magnitude : number->magnitude);
}

Value::Content boolean_content(const Value& value)
{
    if (const auto* flag = value.as<bool>())
        return *flag;
    const auto* string = value.as<Text>();
    const auto flag = string ? read_boolean_text(*string) : std::nullopt;
    return flag ? Value::Content(*flag) : Value::Content();
}

// A decimal number; too large for a double is none.
std::optional<double> read_decimal(std::string_view text)
{
    if (text.starts_with('+'))
        text.remove_prefix(1);
    double number = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    if (text.empty() || error != std::errc() || end != text.data() + text.size())
        return std::nullopt;
    return number;
}

// A text that is no finite number of the type is refused, but for the three names that XML has for the others (DSP0201).
std::optional<double> read_real(std::string_view text, CMPIType type)
{
    if (text == "INF" || text == "-INF")
        return text == "INF" ? HUGE_VAL : -HUGE_VAL;
    if (text == "NaN")
        return NAN;
    const auto number = read_decimal(text);
    const bool fits = number && std::isfinite(type == CMPI_real32 ? static_cast<float>(*number) : *number);
    return fits ? number : std::nullopt;
}

Value::Content real_content(const Value& value, CMPIType type)
{
    if (const auto* number = value.as<double>())
        return *number;
    const auto* string = value.as<Text>();
    const auto number = string ? read_real(trimmed(*string), type) : std::nullopt;
    return number ? Value::Content(*number) : Value::Content();
}

// The one character of a text, when it is of the Basic Multilingual Plane.
Value::Content char16_content(const Value& value, const Cim_Type& type)
{
    const auto* string = value.as<Text>();
    if (!string)
        return integer_content(value, type);
    const text::Character character = text::first_character(*string);
    const bool fits = character.size > 0 && character.size == string->view().size() && character.code <= 0xFFFF;
    return fits ? Value::Content(std::uint64_t{character.code}) : Value::Content();
}

Value::Content text_content(const Value& value) { return value.as<Text>() ? value.content : Value::Content(); }

Value::Content datetime_content(const Value& value)
{
    const auto* string = value.as<Text>();
    const std::string datetime(string ? trimmed(*string) : "");
    return is_readable_datetime(datetime) ? Value::Content(datetime) : Value::Content();
}

} // namespace

Value::Content scalar_content(const Value& value, CMPIType type)
{
    switch (type)
    {
    case CMPI_boolean:
        return boolean_content(value);
    case CMPI_char16:
        return char16_content(value, *find_type(type));
    case CMPI_real32:
    case CMPI_real64:
        return real_content(value, type);
    case CMPI_string:
        return text_content(value);
    case CMPI_dateTime:
        return datetime_content(value);
    default:
        return integer_content(value, *find_type(type));
    }
}

std::optional<bool> read_boolean_text(std::string_view text)
{
    const std::string_view word = trimmed(text);
    if (equal_names(word, "true"))
        return true;
    return equal_names(word, "false") ? std::optional(false) : std::nullopt;
}

bool is_number_text(std::string_view text) { return text::read_integer(trimmed(text)) || read_decimal(trimmed(text)); }

std::string_view trimmed(std::string_view text)
{
    constexpr std::string_view blanks = " \t\r\n";
    const std::size_t first = text.find_first_not_of(blanks);
    return first == std::string_view::npos ? std::string_view() : text.substr(first, text.find_last_not_of(blanks) - first + 1);
}

} // namespace cimserver
