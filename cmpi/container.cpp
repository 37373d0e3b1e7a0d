#include "cmpi/container.h"

#include "runtime/features.h"
#include "runtime/log.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "Container";

bool selected(const Meta_Feature* feature, uint32 mask) { return mask == 0 || (feature->flags & mask) != 0; }

// Keys stand among the first features: what follows the last of them is not looked at.
std::span<const Meta_Feature* const> up_to_last_key(const Meta_Class* meta_class)
{
    const auto features = features_of(meta_class);
    std::size_t size = 0;
    for (uint32 left = meta_class->num_keys; left > 0 && size < features.size(); ++size)
        left -= is_key(features[size]) ? 1U : 0U;
    return features.first(size);
}

} // namespace

int Container::convert(const Meta_Class* meta_class, uint32 mask, Ref<Instance>& instance)
{
    uint32 size = 0;
    if (get_size(size) != 0)
        return -1;
    if (!instance)
        instance.reset(create(meta_class, false));
    nullify_properties(instance.ptr());
    const Meta_Record* record = record_of(instance.ptr());

    for (uint32 i = 0; i < size; ++i)
    {
        const char* name = nullptr;
        if (get_name(i, name) != 0)
        {
            ZMLR_LOG(LL_WARN, "get_name() failed: class=%s, index=%u", record->name, i);
            continue;
        }
        const Meta_Feature* feature = find_feature(record, name, Flag_Property | Flag_Reference);
        if (!feature)
        {
            ZMLR_LOG(LL_WARN, "unknown feature: %s.%s", record->name, name);
            continue;
        }
        if (!selected(feature, mask))
            continue;
        const Value::Type type = type_of(feature);
        if (type == Value::NONE)
        {
            ZMLR_LOG(LL_WARN, "unexpected error: %s.%s", record->name, name);
            continue;
        }
        Value value;
        if (get_value(i, type, value) != 0 || value.give(instance.ptr(), feature) != 0)
            ZMLR_LOG(LL_WARN, "conversion error: %s.%s", record->name, name);
    }
    return 0;
}

int Container::convert(const Instance* instance, uint32 mask)
{
    return carry(instance, mask, [](const Meta_Property*) {});
}

int Container::convert_and_end(const Ref<Instance>& instance, uint32 mask)
{
    if (is_shared(instance.ptr()))
        return convert(instance.ptr(), mask);
    return carry(instance.ptr(), mask, [&](const Meta_Property* property) { end_value(instance.ptr(), property); });
}

// Tells which of the properties that take memory of their own are in the container.
template <class Done> int Container::carry(const Instance* instance, uint32 mask, Done done)
{
    if (!instance)
    {
        ZMLR_LOG(LL_WARN, "ignored null instance arg");
        return -1;
    }
    const Meta_Record* record = record_of(instance);

    const uint32 wanted = mask != 0 ? mask : Flag_Property | Flag_Reference;
    Value value;
    for (const Meta_Feature* feature : mask == Flag_Key ? up_to_last_key(instance->meta_class) : features_of(record))
    {
        if (!(feature->flags & wanted) || is_method(feature) || is_null(instance, feature))
            continue;
        if (const Meta_Property* property = to_property(feature))
            value.borrow(type_of(property), address_of(instance, property->offset));
        else if (value.borrow(instance, feature) != 0)
        {
            ZMLR_LOG(LL_WARN, "unexpected failure: %s.%s", record->name, feature->name);
            continue;
        }
        if (set_value(feature->name, value, feature->flags) != 0)
            ZMLR_LOG(LL_WARN, "conversion error: %s.%s", record->name, feature->name);
        else if (const Meta_Property* property = to_property(feature); property && takes_memory(property))
            done(property);
    }
    return 0;
}

} // namespace zmlr
