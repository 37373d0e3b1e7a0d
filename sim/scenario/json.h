// Reading JSON strictly: every value is asked for by key, checked, and an error names the exact place.
//
//     Json_Document document(text);
//     auto port = document.root("port");
//     auto speed = port.choice("speed", speed_names, max_u32, 8);
//     port.done();                                 // throws for a key that nobody asked for
//
// Every function throws std::runtime_error with "PLACE: what is wrong" when the value is of the wrong type or out of
// range; an absent key yields the default. A Json_Object refers to its document and must not outlive it.
//
// And writing it. json.cpp alone sees the JSON library.
#pragma once

#include <nlohmann/json_fwd.hpp>

#include <array>
#include <cstdint>
#include <map>
#include <memory>
#include <optional>
#include <set>
#include <span>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

namespace hxasim
{

// A word that a scenario may write for a number.
struct Choice
{
    std::string_view word;
    std::uint32_t value;
};

constexpr std::uint32_t max_u32 = 0xFFFFFFFF; // the largest of most numbers

[[noreturn]] void refuse(const std::string& place, const std::string& what);

class Json_Object
{
public:
    Json_Object(const nlohmann::json& value, std::string place);

    // One without any key.
    static Json_Object empty(std::string place);

    const std::string& place() const { return _place; }
    std::string place_of(std::string_view key) const;
    bool has(std::string_view key) const;

    bool boolean(std::string_view key, bool otherwise);

    // A whole number from 0 to `most`, written as a number or as text in hexadecimal ("0x1020").
    std::uint32_t number(std::string_view key, std::uint32_t most, std::uint32_t otherwise);
    std::optional<std::uint32_t> number(std::string_view key, std::uint32_t most);

    // A list of at most `longest` whole numbers from 0 to `most`; an absent key is an empty list.
    std::vector<std::uint64_t> numbers(std::string_view key, std::size_t longest, std::uint64_t most);

    // One of the words, or a bare number up to `most` (drivers deliver values that have no name).
    std::uint32_t choice(std::string_view key, std::span<const Choice> words, std::uint32_t most, std::uint32_t otherwise);
    std::uint32_t word(std::string_view key, std::span<const Choice> words); // required, no bare number

    // A text of at most `longest` bytes; a text as long as its field is delivered without a terminator. What is no text is
    // written as its bytes: {"hex": "FF0041"}.
    std::string text(std::string_view key, std::size_t longest, std::string_view otherwise);

    // Bytes written as hexadecimal digits, first byte first.
    std::vector<std::uint8_t> bytes(std::string_view key, std::size_t longest);

    template <std::size_t size>
    std::array<std::uint8_t, size> address(std::string_view key, const std::array<std::uint8_t, size>& otherwise)
    {
        auto address = otherwise;
        if (find(key))
            read_address(key, address);
        return address;
    }

    std::optional<Json_Object> object(std::string_view key);

    // A list of objects; an object by itself is a list of one.
    std::vector<Json_Object> objects(std::string_view key, std::size_t most);

    void done() const;

private:
    const nlohmann::json* find(std::string_view key);
    void read_address(std::string_view key, std::span<std::uint8_t> address);

    const nlohmann::json* _value;
    std::string _place;
    std::set<std::string, std::less<>> _asked;
};

class Json_Document
{
public:
    // Throws std::runtime_error that tells line and column where `text` is no JSON.
    explicit Json_Document(std::string_view text);
    ~Json_Document();
    Json_Document(const Json_Document&) = delete;
    Json_Document& operator=(const Json_Document&) = delete;

    Json_Object root(std::string place) const;

private:
    std::unique_ptr<const nlohmann::json> _root;
};

// A value to be written.
struct Json_Value
{
    using List = std::vector<Json_Value>;
    using Members = std::map<std::string, Json_Value>;

    std::variant<bool, std::uint64_t, std::string, List, Members> value;
};

// In one line, members in the order of their keys; bytes that are no UTF-8 become replacement characters.
std::string json_text(const Json_Value& value);

// JSON text with its members on lines of their own.
std::string indented_json(std::string_view text);

} // namespace hxasim
