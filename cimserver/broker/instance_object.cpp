#include "cimserver/broker/cmpi_values.h"
#include "cimserver/broker/not_offered.h"
#include "cimserver/broker/objects.h"

namespace cimserver
{
namespace
{

std::size_t visible_slot(const Instance_Object& instance, const char* name)
{
    const auto slot = instance.layout().find(required(name));
    if (!slot || !instance.visible(*slot))
        throw Failure{CMPI_RC_ERR_NO_SUCH_PROPERTY};
    return *slot;
}

CMPICount visible_count(const Instance_Object& instance)
{
    CMPICount count = 0;
    for (std::size_t slot = 0; slot < instance.layout().size(); ++slot)
        count += instance.visible(slot) ? 1U : 0U;
    return count;
}

// The slot of the index-th property in view.
std::size_t visible_slot(const Instance_Object& instance, CMPICount index)
{
    for (std::size_t slot = 0; slot < instance.layout().size(); ++slot)
        if (instance.visible(slot) && index-- == 0)
            return slot;
    throw Failure{CMPI_RC_ERR_NO_SUCH_PROPERTY};
}

CMPIData get_property(const CMPIInstance* self, const char* name, CMPIStatus* status) noexcept
{
    return answer(status, no_data(),
                  [&]
                  {
                      const auto& instance = object<Instance_Object>(self);
                      return to_cmpi(instance.value(visible_slot(instance, name)));
                  });
}

CMPIData get_property_at(const CMPIInstance* self, CMPICount index, CMPIString** name, CMPIStatus* status) noexcept
{
    return answer(status, no_data(),
                  [&]
                  {
                      const auto& instance = object<Instance_Object>(self);
                      const std::size_t slot = visible_slot(instance, index);
                      if (name)
                          *name = make<String_Object>(instance.layout().slots()[slot].name).face();
                      return to_cmpi(instance.value(slot));
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
        if (const auto slot = layout.find(*names))
            filter[*slot] = true;
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
    const auto slot = _layout->find(name);
    if (!slot)
        throw Failure{CMPI_RC_ERR_NO_SUCH_PROPERTY};
    if (value.type != CMPI_null && value.type != _layout->slots()[*slot].type)
        throw Failure{CMPI_RC_ERR_TYPE_MISMATCH};
    if (visible(*slot))
        _properties.set(*slot, std::move(value));
}

void Instance_Object::filter(const char** properties, const char** keys)
{
    _filter = {};
    if (!properties)
        return;

    std::vector<bool> filter(_layout->size());
    for (std::size_t slot = 0; slot < _layout->size(); ++slot)
        filter[slot] = _layout->slots()[slot].key;
    show_named(*_layout, properties, filter);
    show_named(*_layout, keys, filter);
    _filter = std::move(filter);
}

Instance Instance_Object::model(const std::vector<bool>* selection) const
{
    if (!selection && (*_filter).empty())
        return {path, _properties};
    std::vector<Named_Value> shown;
    for (std::size_t slot = 0; slot < _layout->size(); ++slot)
        if (visible(slot) && (!selection || (*selection)[slot]))
            shown.push_back({_layout->slots()[slot].name, value(slot)});
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
