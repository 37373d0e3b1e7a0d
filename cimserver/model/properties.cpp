#include "cimserver/model/names.h"
#include "cimserver/model/values.h"

#include <algorithm>

namespace cimserver
{

Properties::operator std::vector<Named_Value>() const
{
    std::vector<Named_Value> result = *_list;
    for (const Own& own : _own)
        result[own.place].value = own;
    return result;
}

const Value& Properties::operator[](std::size_t place) const
{
    const auto own = std::ranges::lower_bound(_own, place, {}, &Own::place);
    return own != _own.end() && own->place == place ? *own : (*_list)[place].value;
}

const Value* Properties::find(std::string_view name) const
{
    const Named_Value* listed = find_named(*_list, name);
    return listed ? &(*this)[static_cast<std::size_t>(listed - (*_list).data())] : nullptr;
}

void Properties::set(std::size_t place, Value&& value)
{
    constexpr std::size_t growth = 8; // most instances have few values, and not twice as many when they have one more
    if (value.null())
        value.type = (*_list)[place].value.type;
    if (_own.size() == _own.capacity())
        _own.reserve(_own.size() + growth);
    if (_own.empty() || _own.back().place < place) // most are set in their order
        return static_cast<void>(_own.emplace_back(std::move(value), place));
    const auto own = std::ranges::lower_bound(_own, place, {}, &Own::place);
    if (own->place == place)
        *own = Own(std::move(value), place);
    else
        _own.emplace(own, std::move(value), place);
}

void Properties::put(Name name, Value value)
{
    if (const Named_Value* listed = find_named(*_list, name))
        return set(static_cast<std::size_t>(listed - (*_list).data()), std::move(value));
    std::vector<Named_Value> longer = *_list;
    longer.push_back({std::move(name), std::move(value)});
    _list = std::move(longer);
}

} // namespace cimserver
