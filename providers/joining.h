// One enumeration of an association class: what a match works with.
#pragma once

#include "providers/join.h"
#include "providers/key_index.h"

#include <cstddef>
#include <functional>
#include <optional>

namespace zmlr
{

class Joining
{
public:
    // `deliver` takes over an association; false when it has enough. `log_source` is the provider that logs.
    using Deliver = std::function<bool(Instance* association)>;
    Joining(const Join& row, const char* log_source, Deliver deliver);

    // Asks for the elements of a side; in the place of what is not of its class stands null then. False, with the side's log
    // lines, when the side does not have the elements that it needs. A side with an owner is asked for one element of it.
    bool ask(std::size_t side, const Instance* owner = nullptr);

    // Asks for all sides, in their order, and says that they are joined now; false when one does not have what it needs.
    bool ask_all();
    void say_none(std::size_t side) const;
    void say_building() const;

    // Whether the row has such a side. The elements that were asked for last.
    bool has(std::size_t side) const { return side < max_sides && _row.sides[side].meta_class; }
    const Instance_Array& operator[](std::size_t side) const { return *_elements[side]; }
    template <class T> T* at(std::size_t side, uint32 i) const { return static_cast<T*>((*this)[side][i]); }
    String key(std::size_t side, uint32 i) const { return _row.sides[side].key((*this)[side][i]); }

    // Delivers an association of two elements (null is no element: there is none then), or one that is filled already. False when
    // the match is to end.
    bool pair(std::size_t side, Instance* element, std::size_t other_side, Instance* other);
    bool deliver(Ref<Instance> association) { return _deliver(association.steal()); }

    const char* source() const { return _source; }

private:
    const Join& _row;
    const char* _source;
    Deliver _deliver;
    Inventory_Request _request;
    std::optional<Instance_Array> _elements[max_sides];
};

// The elements of a side by their keys.
Key_Index index_of(const Joining& joining, std::size_t side);

// The second half of equal_keys, for any two sides; false when the match is to end.
bool pair_equal_keys(Joining& joining, std::size_t side, std::size_t other_side);

} // namespace zmlr
