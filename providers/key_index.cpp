#include "providers/key_index.h"

#include "runtime/ascii.h"

#include <cstdint>

namespace zmlr
{

// FNV-1a, of the letters in lower case.
std::size_t Key_Index::Hash::operator()(const String& key) const
{
    std::uint64_t hash = 0xCBF29CE484222325;
    for (const char* c = key.c_str(); *c; c++)
        hash = (hash ^ ascii::to_lower(*c)) * 0x100000001B3;
    return static_cast<std::size_t>(hash);
}

void Key_Index::add(const String& key, uint32 position)
{
    if (!key.empty())
        _positions[key].push_back(position);
}

const std::vector<uint32>& Key_Index::at(const String& key) const
{
    static const std::vector<uint32> none;
    const auto found = _positions.find(key);
    return found == _positions.end() ? none : found->second;
}

} // namespace zmlr
