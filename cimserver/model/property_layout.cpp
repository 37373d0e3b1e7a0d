#include "cimserver/model/property_layout.h"

#include "cimserver/model/cim_types.h"
#include "cimserver/model/meta_search.h"

namespace cimserver
{
namespace
{

std::vector<Named_Value> nulls_of(const zmlr::Meta_Class& meta_class)
{
    std::vector<Named_Value> nulls;
    for (const zmlr::Meta_Feature* feature : features_of(meta_class))
        if (!zmlr::is_method(feature))
        {
            nulls.emplace_back().name = feature->name;
            nulls.back().value.type = cmpi_type(*feature);
        }
    return nulls;
}

std::vector<Named_Value> nulls_of(const Instance& instance)
{
    std::vector<Named_Value> nulls = instance.properties;
    for (Named_Value& property : nulls)
        property.value.content = {};
    return nulls;
}

} // namespace

CMPIType cmpi_type(const zmlr::Meta_Feature& feature)
{
    if (zmlr::is_reference(&feature))
        return zmlr::as_reference(&feature)->subscript != 0 ? array_of(CMPI_ref) : CMPIType{CMPI_ref};
    const zmlr::Meta_Property* property = zmlr::as_property(&feature);
    const CMPIType type = cmpi_type(property->type);
    return property->subscript != 0 ? array_of(type) : type;
}

Property_Layout::Property_Layout(std::vector<Named_Value> nulls) : _nulls(std::move(nulls)), _keys(_list.size())
{
    _index.reserve(size());
    for (std::size_t place = 0; place < size(); ++place)
        _index.emplace(_list[place].name, place);
}

Property_Layout::Property_Layout(const zmlr::Meta_Class& meta_class) : Property_Layout(nulls_of(meta_class))
{
    for (const zmlr::Meta_Feature* feature : features_of(meta_class))
        if (zmlr::is_key(feature))
            _keys[*find(feature->name)] = true;
}

Property_Layout::Property_Layout(const Instance& instance) : Property_Layout(nulls_of(instance))
{
    for (const Named_Value& key : instance.path.keys)
        if (const auto place = find(key.name))
            _keys[*place] = true;
}

std::optional<std::size_t> Property_Layout::find(std::string_view name) const
{
    const auto found = _index.find(name);
    return found == _index.end() ? std::nullopt : std::optional(found->second);
}

std::vector<bool> Property_Layout::select(const std::vector<std::string>& names) const
{
    std::vector<bool> selection(size());
    for (const std::string& name : names)
        if (const auto place = find(name))
            selection[*place] = true;
    return selection;
}

std::vector<std::string> Property_Layout::names(const Property_List& wanted) const
{
    const std::vector<bool> selected = wanted ? select(*wanted) : std::vector<bool>(size(), true);
    std::vector<std::string> result;
    for (std::size_t place = 0; place < size(); ++place)
        if (selected[place])
            result.push_back(_list[place].name);
    return result;
}

} // namespace cimserver
