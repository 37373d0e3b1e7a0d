// Property_Layout: the properties of a class in class order, with their types, found by name in constant time.
//
// Instances share the layout of their class, so that making one costs the values that it has.
#pragma once

#include "cimserver/model/names.h"
#include "cimserver/model/values.h"
#include "runtime/meta.h"

#include <cstddef>
#include <optional>
#include <string_view>

namespace cimserver
{

class Property_Layout
{
public:
    struct Slot
    {
        Name name;
        CMPIType type;
        bool key;
    };

    explicit Property_Layout(const zmlr::Meta_Class& meta_class); // its properties and references
    explicit Property_Layout(const Instance& instance);           // for an instance whose class the module does not know
    Property_Layout(const Property_Layout&) = delete;
    Property_Layout& operator=(const Property_Layout&) = delete;

    const std::vector<Slot>& slots() const { return _slots; }
    const Properties::List& nulls() const { return _nulls; } // every slot without a value
    std::size_t size() const { return _slots.size(); }
    std::optional<std::size_t> find(std::string_view name) const;

    // One flag a slot, set for the slots that the list names; names that the layout lacks are passed over.
    std::vector<bool> select(const std::vector<std::string>& names) const;

    // The names of the slots that the list names, of all without a list.
    std::vector<std::string> names(const Property_List& wanted) const;

private:
    void index_slots();

    std::vector<Slot> _slots;
    Properties::List _nulls;
    Name_Map<std::size_t> _index;
};

// The CMPI type of a property or reference, the array bit included.
CMPIType cmpi_type(const zmlr::Meta_Feature& feature);

} // namespace cimserver
