// CIM names are compared without regard to the case of ASCII letters: the comparison, and a hash that agrees with it.
#pragma once

#include <algorithm>
#include <cstddef>
#include <ranges>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace cimserver
{

bool equal_names(std::string_view a, std::string_view b);
std::string lower_name(std::string_view name); // the one spelling that all equal names share

struct Name_Hash
{
    std::size_t operator()(std::string_view name) const;
};

struct Name_Equal
{
    bool operator()(std::string_view a, std::string_view b) const { return equal_names(a, b); }
};

// Whether a list of texts holds the name.
template <class List> bool is_among(const List& list, std::string_view name)
{
    return std::ranges::any_of(list, [&](std::string_view one) { return equal_names(one, name); });
}

// Looks up by name; the texts behind the keys must outlive the map.
template <class T> using Name_Map = std::unordered_map<std::string_view, T, Name_Hash, Name_Equal>;

// The element of a list of named things that has the name, or null.
template <std::ranges::borrowed_range List>
auto find_named(List&& list, std::string_view name) -> decltype(std::ranges::data(list))
{
    for (auto& element : list)
        if (equal_names(element.name, name))
            return &element;
    return nullptr;
}

} // namespace cimserver
