#include "sim/scenario/json.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <charconv>
#include <stdexcept>

namespace hxasim
{

namespace
{

using nlohmann::json;

std::string range(std::uint32_t most) { return "a whole number from 0 to " + std::to_string(most); }

std::optional<std::uint32_t> parse_hexadecimal(std::string_view text)
{
    if (!text.starts_with("0x"))
        return std::nullopt;
    text.remove_prefix(2);
    std::uint32_t value = 0;
    auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value, 16);
    if (error != std::errc() || end != text.data() + text.size())
        return std::nullopt;
    return value;
}

std::optional<std::uint32_t> parse_number(const json& value, std::uint32_t most)
{
    std::optional<std::uint32_t> number;
    if (value.is_string())
        number = parse_hexadecimal(value.get_ref<const std::string&>());
    else if (value.is_number_unsigned() && value.get<std::uint64_t>() <= most)
        number = value.get<std::uint32_t>();
    return number && *number <= most ? number : std::nullopt;
}

std::optional<std::uint8_t> parse_digit(char digit)
{
    constexpr std::string_view digits = "0123456789ABCDEF";
    constexpr std::string_view lower = "0123456789abcdef";
    auto at = std::min(digits.find(digit), lower.find(digit));
    return at < digits.size() ? std::optional(static_cast<std::uint8_t>(at)) : std::nullopt;
}

std::optional<std::vector<std::uint8_t>> parse_bytes(const json& value)
{
    if (!value.is_string())
        return std::nullopt;
    const auto& text = value.get_ref<const std::string&>();
    if (text.size() % 2 != 0)
        return std::nullopt;
    std::vector<std::uint8_t> bytes;
    for (std::size_t i = 0; i < text.size(); i += 2)
    {
        auto high = parse_digit(text[i]);
        auto low = parse_digit(text[i + 1]);
        if (!high || !low)
            return std::nullopt;
        bytes.push_back(static_cast<std::uint8_t>(*high << 4 | *low));
    }
    return bytes;
}

std::optional<std::string> parse_text(const json& value)
{
    if (value.is_string())
        return value.get<std::string>();
    const auto bytes = value.is_object() && value.size() == 1 && value.contains("hex") ? parse_bytes(value["hex"]) : std::nullopt;
    return bytes ? std::optional(std::string(bytes->begin(), bytes->end())) : std::nullopt;
}

std::string listed(std::span<const Choice> words)
{
    std::string list;
    for (const auto& choice : words)
        list += (list.empty() ? "" : ", ") + std::string(choice.word);
    return list;
}

const Choice* chosen(const json& value, std::span<const Choice> words)
{
    if (!value.is_string())
        return nullptr;
    const auto& text = value.get_ref<const std::string&>();
    auto found = std::find_if(words.begin(), words.end(), [&](const Choice& choice) { return choice.word == text; });
    return found == words.end() ? nullptr : &*found;
}

json as_json(const Json_Value& value);

json as_json(const Json_Value::List& list)
{
    json items = json::array();
    for (const auto& item : list)
        items.push_back(as_json(item));
    return items;
}

json as_json(const Json_Value::Members& members)
{
    json object = json::object();
    for (const auto& [key, member] : members)
        object[key] = as_json(member);
    return object;
}

template <typename Scalar> json as_json(const Scalar& scalar) { return scalar; }

json as_json(const Json_Value& value)
{
    return std::visit([](const auto& held) { return as_json(held); }, value.value);
}

} // namespace

void refuse(const std::string& place, const std::string& what) { throw std::runtime_error(place + ": " + what); }

Json_Document::Json_Document(std::string_view text)
try : _root(std::make_unique<json>(json::parse(text)))
{
}
catch (const json::exception& error)
{
    throw std::runtime_error(error.what());
}

Json_Document::~Json_Document() = default;

Json_Object Json_Document::root(std::string place) const { return {*_root, std::move(place)}; }

Json_Object Json_Object::empty(std::string place)
{
    static const json no_keys = json::object();
    return {no_keys, std::move(place)};
}

Json_Object::Json_Object(const json& value, std::string place) : _value(&value), _place(std::move(place))
{
    if (!value.is_object())
        refuse(_place.empty() ? "scenario" : _place, "must be an object");
}

std::string Json_Object::place_of(std::string_view key) const
{
    return _place.empty() ? std::string(key) : _place + "." + std::string(key);
}

bool Json_Object::has(std::string_view key) const { return _value->contains(key); }

const json* Json_Object::find(std::string_view key)
{
    _asked.emplace(key);
    auto found = _value->find(key);
    return found == _value->end() ? nullptr : &*found;
}

bool Json_Object::boolean(std::string_view key, bool otherwise)
{
    const json* value = find(key);
    if (!value)
        return otherwise;
    if (!value->is_boolean())
        refuse(place_of(key), "must be true or false");
    return value->get<bool>();
}

std::optional<std::uint32_t> Json_Object::number(std::string_view key, std::uint32_t most)
{
    const json* value = find(key);
    if (!value)
        return std::nullopt;
    auto number = parse_number(*value, most);
    if (!number)
        refuse(place_of(key), "must be " + range(most));
    return number;
}

std::uint32_t Json_Object::number(std::string_view key, std::uint32_t most, std::uint32_t otherwise)
{
    return number(key, most).value_or(otherwise);
}

std::vector<std::uint64_t> Json_Object::numbers(std::string_view key, std::size_t longest, std::uint64_t most)
{
    std::vector<std::uint64_t> numbers;
    const json* list = find(key);
    if (!list)
        return numbers;
    auto fits = [=](const json& value) { return value.is_number_unsigned() && value.get<std::uint64_t>() <= most; };
    if (!list->is_array() || list->size() > longest || !std::all_of(list->begin(), list->end(), fits))
        refuse(place_of(key),
               "must be a list of at most " + std::to_string(longest) + " whole numbers from 0 to " + std::to_string(most));
    for (const auto& value : *list)
        numbers.push_back(value.get<std::uint64_t>());
    return numbers;
}

std::uint32_t Json_Object::choice(std::string_view key, std::span<const Choice> words, std::uint32_t most,
                                  std::uint32_t otherwise)
{
    const json* value = find(key);
    if (!value)
        return otherwise;
    if (const Choice* choice = chosen(*value, words))
        return choice->value;
    auto number = parse_number(*value, most);
    if (!number)
        refuse(place_of(key), "must be one of " + listed(words) + ", or " + range(most));
    return *number;
}

std::uint32_t Json_Object::word(std::string_view key, std::span<const Choice> words)
{
    const json* value = find(key);
    const Choice* choice = value ? chosen(*value, words) : nullptr;
    if (!choice)
        refuse(place_of(key), "must be one of " + listed(words));
    return choice->value;
}

std::string Json_Object::text(std::string_view key, std::size_t longest, std::string_view otherwise)
{
    const json* value = find(key);
    if (!value)
        return std::string(otherwise);
    auto text = parse_text(*value);
    if (!text || text->size() > longest)
        refuse(place_of(key), "must be a text of at most " + std::to_string(longest) + " bytes");
    return *text;
}

std::vector<std::uint8_t> Json_Object::bytes(std::string_view key, std::size_t longest)
{
    const json* value = find(key);
    if (!value)
        return {};
    auto bytes = parse_bytes(*value);
    if (!bytes || bytes->size() > longest)
        refuse(place_of(key), "must be at most " + std::to_string(longest) + " bytes as hexadecimal digits");
    return *bytes;
}

void Json_Object::read_address(std::string_view key, std::span<std::uint8_t> address)
{
    auto bytes = parse_bytes(*find(key));
    if (!bytes || bytes->size() != address.size())
        refuse(place_of(key), "must be " + std::to_string(2 * address.size()) + " hexadecimal digits");
    std::copy(bytes->begin(), bytes->end(), address.begin());
}

std::optional<Json_Object> Json_Object::object(std::string_view key)
{
    const json* value = find(key);
    return value ? std::optional(Json_Object(*value, place_of(key))) : std::nullopt;
}

std::vector<Json_Object> Json_Object::objects(std::string_view key, std::size_t most)
{
    std::vector<Json_Object> objects;
    const json* value = find(key);
    if (!value)
        return objects;
    if (value->is_object())
        return {Json_Object(*value, place_of(key))};
    if (!value->is_array() || value->size() > most)
        refuse(place_of(key), "must be a list of at most " + std::to_string(most) + " objects");
    for (const auto& item : *value)
        objects.emplace_back(item, place_of(key) + "[" + std::to_string(objects.size()) + "]");
    return objects;
}

void Json_Object::done() const
{
    for (const auto& [key, value] : _value->items())
        if (!_asked.contains(key))
            refuse(place_of(key), "unknown key");
}

std::string json_text(const Json_Value& value) { return as_json(value).dump(-1, ' ', false, json::error_handler_t::replace); }

std::string indented_json(std::string_view text) { return json::parse(text).dump(2); }

} // namespace hxasim
