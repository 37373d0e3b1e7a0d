#include "providers/joining.h"

#include <algorithm>

namespace zmlr
{

namespace
{

Instance_Array asked(const Side& side, const Instance* owner, const Inventory_Request& request)
{
    return side.ask_of ? side.ask_of(owner, request) : side.ask(request);
}

void drop_others(Instance_Array& elements, const Meta_Class* meta_class)
{
    for (Instance*& place : elements)
    {
        if (place && !is_subclass(meta_class, place->meta_class))
        {
            unref(place);
            place = nullptr;
        }
    }
}

} // namespace

Joining::Joining(const Join& row, const char* log_source, Deliver deliver)
    : _row(row)
    , _source(log_source)
    , _deliver(std::move(deliver))
{
}

bool Joining::ask(std::size_t i, const Instance* owner)
{
    const Side& side = _row.sides[i];
    _elements[i].reset(); // what is asked for once more is not held twice
    Instance_Array& elements = _elements[i].emplace(asked(side, owner, _request));
    const bool is_several = side.need == Need::exactly_one && elements.size() > 1;
    drop_others(elements, side.meta_class);

    if (is_several && side.several.text)
        say({&side.several, 1}, _source);
    else if (elements.empty() || is_several)
        say_none(i);
    return !is_several && (!elements.empty() || side.need == Need::any);
}

bool Joining::ask_all()
{
    for (std::size_t i = 0; has(i); i++)
    {
        if (!ask(i))
            return false;
    }
    say_building();
    return true;
}

void Joining::say_none(std::size_t side) const { say(_row.sides[side].none, _source); }

void Joining::say_building() const
{
    const char* const log_source = _source;
    ZMLR_LOG(LL_DBG, "Building and returning association instances");
}

bool Joining::pair(std::size_t side, Instance* element, std::size_t other_side, Instance* other)
{
    if (!element || !other)
        return true;
    Ref<Instance> association(create(_row.meta_class, true));
    _row.sides[side].put(association.ptr(), element);
    _row.sides[other_side].put(association.ptr(), other);
    return deliver(std::move(association));
}

Key_Index index_of(const Joining& joining, std::size_t side)
{
    Key_Index index;
    for (uint32 i = 0; i < joining[side].size(); i++)
    {
        if (joining[side][i])
            index.add(joining.key(side, i), i);
    }
    return index;
}

bool pair_equal_keys(Joining& joining, std::size_t side, std::size_t other_side)
{
    const Key_Index index = index_of(joining, other_side);
    for (uint32 i = 0; i < joining[side].size(); i++)
    {
        Instance* element = joining[side][i];
        if (!element)
            continue;
        for (const uint32 other : index.at(joining.key(side, i)))
        {
            if (!joining.pair(side, element, other_side, joining[other_side][other]))
                return false;
        }
    }
    return true;
}

void all_pairs(Joining& joining)
{
    if (!joining.ask_all())
        return;
    for (Instance* element : joining[0])
    {
        for (std::size_t side = 1; joining.has(side); side++)
        {
            for (Instance* other : joining[side])
            {
                if (!joining.pair(0, element, side, other))
                    return;
            }
        }
    }
}

void equal_keys(Joining& joining)
{
    if (joining.ask_all())
        pair_equal_keys(joining, 0, 1);
}

void same_positions(Joining& joining)
{
    if (!joining.ask_all())
        return;
    const uint32 count = std::min(joining[0].size(), joining[1].size());
    for (uint32 i = 0; i < count && joining.pair(0, joining[0][i], 1, joining[1][i]); i++)
        continue;
}

void with_its_own(Joining& joining)
{
    if (!joining.ask(0))
        return;
    joining.say_building();
    for (Instance* owner : joining[0])
    {
        if (!owner || !joining.ask(1, owner))
            continue;
        for (Instance* element : joining[1])
        {
            if (!joining.pair(0, owner, 1, element))
                return;
        }
    }
}

void keys_within_its_own(Joining& joining)
{
    if (!joining.ask(0))
        return;
    joining.say_building();
    for (const Instance* owner : joining[0])
    {
        if (owner && joining.ask(1, owner) && joining.ask(2, owner) && !pair_equal_keys(joining, 1, 2))
            return;
    }
}

} // namespace zmlr
