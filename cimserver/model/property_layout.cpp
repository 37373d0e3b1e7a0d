#include "cimserver/model/property_layout.h"

#include "cimserver/model/cim_types.h"
#include "cimserver/model/meta_search.h"

namespace cimserver
{
CMPIType cmpi_type(const zmlr::Meta_Feature& feature)
{
    if (zmlr::is_reference(&feature))
        return zmlr::as_reference(&feature)->subscript != 0 ? array_of(CMPI_ref) : CMPIType{CMPI_ref};
    const zmlr::Meta_Property* property = zmlr::as_property(&feature);
    const CMPIType type = cmpi_type(property->type);
    return property->subscript != 0 ? array_of(type) : type;
}

Property_Layout::Property_Layout(const zmlr::Meta_Class& meta_class)
{
    for (const zmlr::Meta_Feature* feature : features_of(meta_class))
        if (!zmlr::is_method(feature))
            _slots.push_back({feature->name, cmpi_type(*feature), zmlr::is_key(feature)});
    index_slots();
}

Property_Layout::Property_Layout(const Instance& instance)
{
    for (const auto& [name, value] : instance.properties)
        _slots.push_back({name, value.type, find_named(instance.path.keys, name) != nullptr});
    index_slots();
}

void Property_Layout::index_slots()
{
    std::vector<Named_Value> nulls;
    _index.reserve(_slots.size());
    for (std::size_t i = 0; i < _slots.size(); ++i)
    {
        _index.emplace(_slots[i].name, i);
        nulls.push_back({_slots[i].name, {_slots[i].type, {}}});
    }
    _nulls = std::move(nulls);
}

std::optional<std::size_t> Property_Layout::find(std::string_view name) const
{
    const auto found = _index.find(name);
    if (found == _index.end())
        return std::nullopt;
    return found->second;
}

std::vector<bool> Property_Layout::select(const std::vector<std::string>& names) const
{
    std::vector<bool> selection(_slots.size());
    for (const std::string& name : names)
        if (const auto slot = find(name))
            selection[*slot] = true;
    return selection;
}

std::vector<std::string> Property_Layout::names(const Property_List& wanted) const
{
    const std::vector<bool> selected = wanted ? select(*wanted) : std::vector<bool>(size(), true);
    std::vector<std::string> result;
    for (std::size_t slot = 0; slot < size(); ++slot)
        if (selected[slot])
            result.push_back(_slots[slot].name);
    return result;
}

} // namespace cimserver
