#include "cimserver/model/names.h"

#include "cimserver/model/values.h"

#include <algorithm>
#include <cstdint>

namespace cimserver
{
namespace
{

constexpr char lower(char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c + ('a' - 'A')) : c; }

} // namespace

bool equal_names(std::string_view a, std::string_view b)
{
    return a == b || std::equal(a.begin(), a.end(), b.begin(), b.end(), [](char x, char y) { return lower(x) == lower(y); });
}

std::string lower_name(std::string_view name)
{
    std::string result(name);
    std::transform(result.begin(), result.end(), result.begin(), lower);
    return result;
}

// FNV-1a, of both cases of a letter alike.
std::size_t Name_Hash::operator()(std::string_view name) const
{
    std::uint64_t hash = 0xcbf29ce484222325;
    for (const char c : name)
        hash = (hash ^ static_cast<unsigned char>(c | ('a' - 'A'))) * 0x100000001b3;
    return static_cast<std::size_t>(hash);
}

Text::Block* Text::make(std::string_view text)
{
    void* room = ::operator new(sizeof(Block) + text.size() + 1);
    char* end = std::ranges::copy(text, static_cast<char*>(room) + sizeof(Block)).out;
    *end = '\0';
    return new (room) Block{1, static_cast<std::uint32_t>(text.size())};
}

void put(std::vector<Named_Value>& list, Name name, Value value)
{
    if (Named_Value* found = find_named(list, name))
        found->value = std::move(value);
    else
        list.push_back({std::move(name), std::move(value)});
}

} // namespace cimserver
