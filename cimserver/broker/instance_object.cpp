#include "cimserver/broker/cmpi_values.h"
#include "cimserver/broker/not_offered.h"
#include "cimserver/broker/objects.h"

namespace cimserver
{
namespace
{

std::size_t visible_place(const Instance_Object& instance, const char* name)
{
    const auto place = instance.layout().find(required(name));
    if (!place || !instance.visible(*place))
        throw Failure{CMPI_RC_ERR_NO_SUCH_PROPERTY};
    return *place;
}

CMPICount visible_count(const Instance_Object& instance)
{
    CMPICount count = 0;
    for (std::size_t place = 0; place < instance.layout().size(); ++place)
        count += instance.visible(place) ? 1U : 0U;
    return count;
}

// The place of the index-th property in view.
std::size_t visible_place(const Instance_Object& instance, CMPICount index)
{
    for (std::size_t place = 0; place < instance.layout().size(); ++place)
        if (instance.visible(place) && index-- == 0)
            return place;
    throw Failure{CMPI_RC_ERR_NO_SUCH_PROPERTY};
}

CMPIData get_property(const CMPIInstance* self, const char* name, CMPIStatus* status) noexcept
{
    return answer(status, no_data(),
                  [&]
                  {
                      const auto& instance = object<Instance_Object>(self);
                      return to_cmpi(instance.value(visible_place(instance, name)));
                  });
}

CMPIData get_property_at(const CMPIInstance* self, CMPICount index, CMPIString** name, CMPIStatus* status) noexcept
{
    return answer(status, no_data(),
                  [&]
                  {
                      const auto& instance = object<Instance_Object>(self);
                      const std::size_t place = visible_place(instance, index);
                      if (name)
                          *name = make<String_Object>(instance.layout()[place].name).face();
                      return to_cmpi(instance.value(place));
                  });
}

CMPICount get_property_count(const CMPIInstance* self, CMPIStatus* status) noexcept
{
    return answer<CMPICount>(status, 0, [&] { return visible_count(object<Instance_Object>(self)); });
}

CMPIStatus set_property(const CMPIInstance* self, const char* name, const CMPIValue* value, CMPIType type) noexcept
{
    return answer([&] { object<Instance_Object>(self).set(required(name), from_cmpi(value, type)); });
}

CMPIObjectPath* get_object_path(const CMPIInstance* self, CMPIStatus* status) noexcept
{
    return answer_new<Path_Object>(status, [&] { return object<Instance_Object>(self).path; });
}

CMPIStatus set_property_filter(CMPIInstance* self, const char** properties, const char** keys) noexcept
{
    return answer([&] { object<Instance_Object>(self).filter(properties, keys); });
}

void show_named(const Property_Layout& layout, const char** names, std::vector<bool>& filter)
{
    for (; names && *names; ++names)
        if (const auto place = layout.find(*names))
            filter[*place] = true;
}

} // namespace

Instance_Object::Instance_Object(std::shared_ptr<const Property_Layout> layout, Object_Path path_)
    : path(std::move(path_))
    , _layout(std::move(layout))
    , _properties(_layout->nulls())
{
}

Instance_Object::Instance_Object(const Instance& instance)
    : path(instance.path)
    , _layout(std::make_shared<const Property_Layout>(instance))
    , _properties(instance.properties)
{
}

void Instance_Object::set(std::string_view name, Value value)
{
    const auto place = _layout->find(name);
    if (!place)
        throw Failure{CMPI_RC_ERR_NO_SUCH_PROPERTY};
    if (value.type != CMPI_null && value.type != (*_layout)[*place].value.type)
        throw Failure{CMPI_RC_ERR_TYPE_MISMATCH};
    if (visible(*place))
        _properties.set(*place, std::move(value));
}

void Instance_Object::filter(const char** properties, const char** keys)
{
    _filter = {};
    if (!properties)
        return;

    std::vector<bool> filter(_layout->size());
    for (std::size_t place = 0; place < _layout->size(); ++place)
        filter[place] = _layout->is_key(place);
    show_named(*_layout, properties, filter);
    show_named(*_layout, keys, filter);
    _filter = std::move(filter);
}

Instance Instance_Object::model(const std::vector<bool>* selection) const
{
    if (!selection && !_filter)
        return {path, _properties};
    std::vector<Named_Value> shown;
    for (std::size_t place = 0; place < _layout->size(); ++place)
        if (visible(place) && (!selection || (*selection)[place]))
            shown.push_back({(*_layout)[place].name, value(place)});
    return {path, std::move(shown)};
}

const CMPIInstanceFT Instance_Object::table = {
    .ftVersion = 100,
    .release = release<Instance_Object>,
    .clone = clone<Instance_Object>,
    .getProperty = get_property,
    .getPropertyAt = get_property_at,
    .getPropertyCount = get_property_count,
    .setProperty = set_property,
    .getObjectPath = get_object_path,
    .setPropertyFilter = set_property_filter,
    .setObjectPath = not_offered,
};

} // namespace cimserver
