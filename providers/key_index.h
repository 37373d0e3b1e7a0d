// The elements of one side of a join by their key texts.
#pragma once

#include "runtime/string.h"

#include <cstddef>
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
    const std::vector<uint32>& at(const String& key) const;

private:
    struct Hash
    {
        std::size_t operator()(const String& key) const;
    };
    struct Equal
    {
        bool operator()(const String& a, const String& b) const { return a.size() == b.size() && a.equali(b); }
    };

    std::unordered_map<String, std::vector<uint32>, Hash, Equal> _positions;
};

} // namespace zmlr
