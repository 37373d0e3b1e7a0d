#include "cimserver/value_conversion.h"

#include "cimserver/broker/names.h"
#include "cimserver/cimxml/value_text.h"

#include <charconv>
#include <cmath>
#include <optional>

namespace cimserver
{
namespace
{

unsigned bits(CMPIType type)
{
    switch (type)
    {
    case CMPI_uint8:
    case CMPI_sint8:
        return 8;
    case CMPI_char16:
    case CMPI_uint16:
    case CMPI_sint16:
        return 16;
    case CMPI_uint32:
    case CMPI_sint32:
        return 32;
    default:
        return 64;
    }
}

bool is_signed(CMPIType type) { return type == CMPI_sint8 || type == CMPI_sint16 || type == CMPI_sint32 || type == CMPI_sint64; }

struct Integer
{
    bool negative;
    std::uint64_t magnitude;
};

template <class Number> std::optional<Number> parse(std::string_view text, auto... format)
{
    Number number{};
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number, format...);
    if (text.empty() || error != std::errc() || end != text.data() + text.size())
        return std::nullopt;
    return number;
}

std::optional<Integer> parse_integer(std::string_view text)
{
    const bool negative = text.starts_with('-');
    if (negative || text.starts_with('+'))
        text.remove_prefix(1);
    const bool hexadecimal = text.starts_with("0x") || text.starts_with("0X");
    const auto magnitude = hexadecimal ? parse<std::uint64_t>(text.substr(2), 16) : parse<std::uint64_t>(text, 10);
    if (!magnitude)
        return std::nullopt;
    return Integer{negative, *magnitude};
}

std::optional<Integer> integer_of(const Value& value)
{
    if (const auto* number = std::get_if<std::uint64_t>(&value.content))
        return Integer{false, *number};
    if (const auto* number = std::get_if<std::int64_t>(&value.content))
        return Integer{*number < 0, *number < 0 ? 0 - static_cast<std::uint64_t>(*number) : static_cast<std::uint64_t>(*number)};
    if (const auto* text = std::get_if<std::string>(&value.content))
        return parse_integer(trimmed(*text));
    return std::nullopt;
}

// The number as the model holds it, or null when the type cannot hold it.
Value::Content integer_content(const Integer& number, CMPIType type)
{
    if (!is_signed(type))
    {
        const std::uint64_t max = bits(type) == 64 ? UINT64_MAX : (std::uint64_t{1} << bits(type)) - 1;
        const bool fits = number.magnitude <= max && (!number.negative || number.magnitude == 0);
        return fits ? Value::Content(number.magnitude) : Value::Content();
    }
    const std::uint64_t limit = std::uint64_t{1} << (bits(type) - 1);
    if (number.negative ? number.magnitude > limit : number.magnitude >= limit)
        return {};
    return static_cast<std::int64_t>(number.negative ? 0 - number.magnitude : number.magnitude);
}

Value::Content boolean_content(const Value& value)
{
    if (const auto* flag = std::get_if<bool>(&value.content))
        return *flag;
    const auto* text = std::get_if<std::string>(&value.content);
    if (text && equal_names(trimmed(*text), "true"))
        return true;
    if (text && equal_names(trimmed(*text), "false"))
        return false;
    return {};
}

// A text that is no finite number of the type is refused, but for the three names that XML has for the others (DSP0201).
std::optional<double> parse_real(std::string_view text, CMPIType type)
{
    if (text == "INF" || text == "-INF")
        return text == "INF" ? HUGE_VAL : -HUGE_VAL;
    if (text == "NaN")
        return NAN;
    if (text.starts_with('+'))
        text.remove_prefix(1);
    const auto number = parse<double>(text);
    const bool fits = number && std::isfinite(type == CMPI_real32 ? static_cast<float>(*number) : *number);
    return fits ? number : std::nullopt;
}

Value::Content real_content(const Value& value, CMPIType type)
{
    if (const auto* number = std::get_if<double>(&value.content))
        return *number;
    if (const auto* text = std::get_if<std::string>(&value.content))
        if (const auto number = parse_real(trimmed(*text), type))
            return *number;
    return {};
}

// The one character of a text, when it is of the Basic Multilingual Plane.
std::optional<std::uint64_t> single_code_unit(const std::string& text)
{
    const auto byte = [&](std::size_t i) { return static_cast<unsigned char>(text[i]); };
    const auto trails = [&](std::size_t i) { return (byte(i) & 0xC0U) == 0x80U; };
    if (text.size() == 1 && byte(0) < 0x80)
        return byte(0);
    if (text.size() == 2 && (byte(0) & 0xE0U) == 0xC0U && trails(1))
        return (byte(0) & 0x1FU) << 6U | (byte(1) & 0x3FU);
    if (text.size() == 3 && (byte(0) & 0xF0U) == 0xE0U && trails(1) && trails(2))
        return (byte(0) & 0x0FU) << 12U | (byte(1) & 0x3FU) << 6U | (byte(2) & 0x3FU);
    return std::nullopt;
}

Value::Content char16_content(const Value& value)
{
    if (const auto* text = std::get_if<std::string>(&value.content))
    {
        const auto unit = single_code_unit(*text);
        return unit ? Value::Content(*unit) : Value::Content();
    }
    const auto number = integer_of(value);
    return number ? integer_content(*number, CMPI_char16) : Value::Content();
}

Value::Content text_content(const Value& value)
{
    const auto* text = std::get_if<std::string>(&value.content);
    return text ? Value::Content(*text) : Value::Content();
}

Value::Content datetime_content(const Value& value)
{
    const auto* text = std::get_if<std::string>(&value.content);
    const std::string datetime(text ? trimmed(*text) : "");
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
        return char16_content(value);
    case CMPI_real32:
    case CMPI_real64:
        return real_content(value, type);
    case CMPI_string:
        return text_content(value);
    case CMPI_dateTime:
        return datetime_content(value);
    default:
    {
        const auto number = integer_of(value);
        return number ? integer_content(*number, type) : Value::Content();
    }
    }
}

} // namespace cimserver
