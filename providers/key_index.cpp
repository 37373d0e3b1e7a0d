#include "providers/key_index.h"

#include "runtime/ascii.h"

#include <algorithm>
#include <cstdint>

namespace zmlr
{

// FNV-1a, of the letters in lower case.
std::size_t Key_Index::hash(std::string_view key)
{
    std::uint64_t value = 0xCBF29CE484222325;
    for (const char c : key)
        value = (value ^ ascii::to_lower(c)) * 0x100000001B3;
    return static_cast<std::size_t>(value);
}

bool Key_Index::equal(std::string_view a, std::string_view b)
{
    return std::ranges::equal(a, b, {}, ascii::to_lower, ascii::to_lower);
}

void Key_Index::add(const String& key, uint32 position)
{
    if (!key.empty())
        _positions[key].push_back(position);
}

const std::vector<uint32>& Key_Index::at(std::string_view key) const
{
    static const std::vector<uint32> none;
    const auto found = _positions.find(key);
    return found == _positions.end() ? none : found->second;
}

} // namespace zmlr
