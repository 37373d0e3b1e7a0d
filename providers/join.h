// The row of an association class: which instances it joins and how they are matched.
//
// A row names its sides in the order in which they are asked for. Roles and keys are members of the generated records, so that
// a row with a role of another class, or with the key of another element, does not compile:
//
//     join(equal_keys, side<&ZEMLAR_X::Antecedent, &ZEMLAR_FCPort::DeviceID>({LL_ERR, "No ports"}),
//                      side<&ZEMLAR_X::Dependent, &ZEMLAR_AlarmDevice::DeviceID>({LL_ERR, "No alarms"}))
#pragma once

#include "providers/enumerations.h"
#include "providers/row_of.h"

#include <cstddef>
#include <type_traits>

namespace zmlr
{

class Joining;

// How many elements a side must have. Without them the enumeration ends there.
enum class Need
{
    some,
    exactly_one,
    any // also none
};

struct Side
{
    const Meta_Class* meta_class = nullptr;  // of the elements
    const Meta_Class* association = nullptr; // whose role they fill; null when they fill none
    const Meta_Class* owner = nullptr;       // of a side that is asked for each element of the first: their class
    Instance_Array (*ask)(const Inventory_Request& request) = nullptr;
    Instance_Array (*ask_of)(const Instance* element, const Inventory_Request& request) = nullptr; // with an owner
    void (*put)(Instance* association, Instance* element) = nullptr;                               // into its role
    String (*key)(const Instance* element) = nullptr; // by which equal_keys matches; empty: matches nothing
    Need need = Need::some;
    Log_Row none[2] = {}; // what is logged when there is no element
    Log_Row several = {}; // what is logged when there are several and need is exactly_one; without a text as for none
};

// Asks for the sides and joins their elements.
using Match = void (*)(Joining& joining);

inline constexpr std::size_t max_sides = 4;

struct Join
{
    const Meta_Class* meta_class;
    Match match;
    Side sides[max_sides]; // those that have a class
};

// ---- the usual matches ----

void all_pairs(Joining& joining);           // each element of the first side with each one of the second, then of the third
void equal_keys(Joining& joining);          // each element of the first side with those of the second that have its key
void same_positions(Joining& joining);      // the first of the first side with the first of the second, and so on
void with_its_own(Joining& joining);        // each element of the first side with those of the second, asked for it
void keys_within_its_own(Joining& joining); // equal_keys of the second and third side, both asked for each element of the first

// ---- the parts of a row; they run in the compiler, but clang 14 knows no consteval function that calls another ----

template <class T, class A> A association_of(T* A::*);
template <class T, class A> T filled_by(T* A::*);
template <class E> E owner_of(Instance_Array (*)(const E&, const Inventory_Request&));

// All instances of a class, asked for as its row of `enumerations` says.
template <class Element> Instance_Array all_of(const Inventory_Request& request)
{
    constexpr const Enumeration& row = row_of(Element::static_meta_class, enumerations);
    return row.get_instances(row.id, request);
}

template <class Element, auto role> void put_into(Instance* association, Instance* element)
{
    using Association = decltype(association_of(role));
    set_reference(static_cast<Association*>(association)->*role, element);
}

template <class Element, auto key> String key_of(const Instance* instance)
{
    const auto& element = *static_cast<const Element*>(instance);
    if constexpr (std::is_member_object_pointer_v<decltype(key)>)
        return (element.*key).null ? String() : (element.*key).value;
    else
        return key(element);
}

// A side whose elements fill no role. `key` is a property or a function of the element.
template <class Element, auto key = nullptr>
constexpr Side side_without_role(Log_Row none = {}, decltype(Side::ask) ask = nullptr)
{
    Side side = {.meta_class = of<Element>, .ask = ask, .none = {none}};
    if constexpr (!std::is_null_pointer_v<decltype(key)>)
        side.key = key_of<Element, key>;
    return side;
}

// A side whose elements fill a role that the association declares for an ancestor of their class.
template <class Element, auto role, auto key = nullptr>
constexpr Side side_of(Log_Row none = {}, decltype(Side::ask) ask = all_of<Element>)
{
    Side side = side_without_role<Element, key>(none, ask);
    side.association = of<decltype(association_of(role))>;
    side.put = put_into<Element, role>;
    return side;
}

// A side whose elements fill a role that the association declares for their class.
template <auto role, auto key = nullptr>
constexpr Side side(Log_Row none = {}, decltype(Side::ask) ask = all_of<decltype(filled_by(role))>)
{
    return side_of<decltype(filled_by(role)), role, key>(none, ask);
}

// The side, asked for each element of the first side: of_each<ports_of>(side<...>()).
template <auto ask_of> constexpr Side of_each(Side side)
{
    using Owner = decltype(owner_of(ask_of));
    side.owner = of<Owner>;
    side.ask_of = [](const Instance* element, const Inventory_Request& request)
    { return ask_of(*static_cast<const Owner*>(element), request); };
    return side;
}

constexpr Side exactly_one(Side side, Log_Row several = {})
{
    side.need = Need::exactly_one;
    side.several = several;
    return side;
}

constexpr Side optional(Side side)
{
    side.need = Need::any;
    return side;
}

// Logs a second line when there is no element.
constexpr Side with_remark(Side side, Log_Row remark)
{
    side.none[1] = remark;
    return side;
}

constexpr Join join(Match match, Side first, Side second, Side third = Side(), Side fourth = Side())
{
    Join row = {.meta_class = nullptr, .match = match, .sides = {first, second, third, fourth}};
    for (const Side& side : row.sides)
    {
        if (side.association && row.meta_class && side.association != row.meta_class)
            throw "the roles of a join belong to one association class";
        if (side.owner && side.owner != first.meta_class)
            throw "a side is asked for the elements of the first one";
        if (side.association)
            row.meta_class = side.association;
    }
    return row;
}

} // namespace zmlr
