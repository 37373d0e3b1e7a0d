// Property_Layout: the properties of a class in class order, with their types, found by name in constant time.
//
// Instances share the layout of their class, so that making one costs the values that it has.
#pragma once

#include "cimserver/model/names.h"
#include "cimserver/model/values.h"
#include "runtime/meta.h"

#include <cstddef>
#include <optional>
#include <span>
#include <string_view>

namespace cimserver
{

class Property_Layout
{
public:
    explicit Property_Layout(const zmlr::Meta_Class& meta_class); // its properties and references
    explicit Property_Layout(const Instance& instance);           // for an instance whose class the module does not know
    Property_Layout(const Property_Layout&) = delete;
    Property_Layout& operator=(const Property_Layout&) = delete;

    // Each property with a null value of its type: what the instances share.
    const Properties::List& nulls() const { return _nulls; }
    const Named_Value& operator[](std::size_t place) const { return _list[place]; }
    bool is_key(std::size_t place) const { return _keys[place]; }
    std::size_t size() const { return _list.size(); }
    std::optional<std::size_t> find(std::string_view name) const; // its place

    // One flag a place, set for the properties that the list names; names that the layout lacks are passed over.
    std::vector<bool> select(const std::vector<std::string>& names) const;

    // The names of the properties that the list names, of all without a list.
    std::vector<std::string> names(const Property_List& wanted) const;

private:
    explicit Property_Layout(std::vector<Named_Value> nulls);

    const Properties::List _nulls;
    const std::span<const Named_Value> _list = *_nulls;
    std::vector<bool> _keys; // one flag a place
    Name_Map<std::size_t> _index;
};

// The CMPI type of a property or reference, the array bit included.
CMPIType cmpi_type(const zmlr::Meta_Feature& feature);

} // namespace cimserver
