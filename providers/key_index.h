// The elements of one side of a join by their key texts.
#pragma once

#include "runtime/string.h"

#include <cstddef>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace zmlr
{

// Keys are compared without regard to case; several elements may have the same. An empty key is none: nothing is found by it.
class Key_Index
{
public:
    void add(const String& key, uint32 position);

    // The positions that were added with the key, in their order.
    const std::vector<uint32>& at(std::string_view key) const;
    const std::vector<uint32>& at(const String& key) const { return at(view(key)); }

private:
    static std::string_view view(std::string_view key) { return key; }
    static std::string_view view(const String& key) { return {key.c_str(), key.size()}; }

    // Of a String or a part of one.
    struct Hash
    {
        using is_transparent = void;
        std::size_t operator()(const auto& key) const { return hash(view(key)); }
    };
    struct Equal
    {
        using is_transparent = void;
        bool operator()(const auto& a, const auto& b) const { return equal(view(a), view(b)); }
    };
    static std::size_t hash(std::string_view key);
    static bool equal(std::string_view a, std::string_view b);

    std::unordered_map<String, std::vector<uint32>, Hash, Equal> _positions;
};

} // namespace zmlr
