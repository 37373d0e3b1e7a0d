#include "cimserver/key_conversion.h"

#include "cimserver/broker/datetime_text.h"

#include <charconv>
#include <cmath>
#include <optional>

namespace cimserver
{
namespace
{

// References in references: no class of any schema comes near this depth, a hostile request may.
constexpr int max_depth = 8;

const char* type_name(CMPIType type)
{
    switch (type)
    {
    // clang-format off
    case CMPI_boolean:  return "boolean";
    case CMPI_char16:   return "char16";
    case CMPI_real32:   return "real32";
    case CMPI_real64:   return "real64";
    case CMPI_uint8:    return "uint8";
    case CMPI_uint16:   return "uint16";
    case CMPI_uint32:   return "uint32";
    case CMPI_uint64:   return "uint64";
    case CMPI_sint8:    return "sint8";
    case CMPI_sint16:   return "sint16";
    case CMPI_sint32:   return "sint32";
    case CMPI_sint64:   return "sint64";
    case CMPI_string:   return "string";
    case CMPI_dateTime: return "datetime";
    case CMPI_ref:      return "reference";
    default:            return "value";
        // clang-format on
    }
}

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
        return parse_integer(*text);
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
    if (text && equal_names(*text, "true"))
        return true;
    if (text && equal_names(*text, "false"))
        return false;
    return {};
}

Value::Content real_content(const Value& value)
{
    if (const auto* number = std::get_if<double>(&value.content))
        return *number;
    if (const auto* text = std::get_if<std::string>(&value.content))
        if (const auto number = parse<double>(*text); number && std::isfinite(*number))
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

Value::Content text_content(const Value& value, CMPIType type)
{
    const auto* text = std::get_if<std::string>(&value.content);
    if (!text || (type == CMPI_dateTime && !parse_datetime(*text)))
        return {};
    return *text;
}

class Converter
{
public:
    explicit Converter(const Repository& repository) : _repository(repository) {}

    std::vector<Named_Value> keys(const Class_Entry& entry, const Object_Path& path)
    {
        if (++_depth > max_depth)
            throw Key_Error("the references in the keys are nested too deeply");

        refuse_unknown_and_repeated(entry, path);
        std::vector<Named_Value> result;
        for (zmlr::uint32 i = 0; i < entry.meta_class->num_meta_features; ++i)
        {
            const zmlr::Meta_Feature* feature = entry.meta_class->meta_features[i];
            if (zmlr::is_key(feature))
                result.push_back({feature->name, converted(entry, *feature, path)});
        }
        --_depth;
        return result;
    }

private:
    [[noreturn]] static void refuse(const std::string& key, const Class_Entry& entry, const std::string& reason)
    {
        throw Key_Error("key " + key + " of class " + std::string(entry.meta_class->name) + ": " + reason);
    }

    static void refuse_unknown_and_repeated(const Class_Entry& entry, const Object_Path& path)
    {
        std::vector<bool> seen(entry.layout->size());
        for (const Named_Value& key : path.keys)
        {
            const auto slot = entry.layout->find(key.name);
            if (!slot || !entry.layout->slots()[*slot].key)
                refuse(key.name, entry, "there is no such key");
            if (seen[*slot])
                refuse(key.name, entry, "it is given twice");
            seen[*slot] = true;
        }
    }

    Value converted(const Class_Entry& entry, const zmlr::Meta_Feature& feature, const Object_Path& path)
    {
        const Named_Value* given = find_named(path.keys, feature.name);
        if (!given || given->value.null())
            refuse(feature.name, entry, "it is missing");

        const CMPIType type = cmpi_type(feature);
        Value value{type, content(given->value, type, feature, path)};
        if (value.null())
            refuse(feature.name, entry, std::string("its value is no ") + type_name(type));
        return value;
    }

    Value::Content content(const Value& value, CMPIType type, const zmlr::Meta_Feature& feature, const Object_Path& path)
    {
        switch (type)
        {
        case CMPI_boolean:
            return boolean_content(value);
        case CMPI_char16:
            return char16_content(value);
        case CMPI_real32:
        case CMPI_real64:
            return real_content(value);
        case CMPI_string:
        case CMPI_dateTime:
            return text_content(value, type);
        case CMPI_ref:
            return reference_content(value, *zmlr::as_reference(&feature), path);
        default:
        {
            const auto number = integer_of(value);
            return number ? integer_content(*number, type) : Value::Content();
        }
        }
    }

    // A reference may name the declared class, one derived from it, or a superclass that a client walked in through.
    Value::Content reference_content(const Value& value, const zmlr::Meta_Reference& reference, const Object_Path& path)
    {
        const auto* target = std::get_if<std::shared_ptr<const Object_Path>>(&value.content);
        const Class_Entry* entry = target && *target ? _repository.find((*target)->class_name) : nullptr;
        if (!entry || !related(entry->meta_class, reference.meta_class))
            return {};

        Object_Path result{(*target)->host, (*target)->name_space, entry->meta_class->name, keys(*entry, **target)};
        if (result.name_space.empty())
            result.name_space = path.name_space;
        return std::make_shared<const Object_Path>(std::move(result));
    }

    static bool related(const zmlr::Meta_Class* a, const zmlr::Meta_Class* b)
    {
        return Repository::is_a(a, b) || Repository::is_a(b, a);
    }

    const Repository& _repository;
    int _depth = 0;
};

} // namespace

std::vector<Named_Value> typed_keys(const Repository& repository, const Class_Entry& entry, const Object_Path& path)
{
    return Converter(repository).keys(entry, path);
}

} // namespace cimserver
