#include "cmpi/container.h"

#include "runtime/log.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "Container";

bool selected(const Meta_Feature* feature, uint32 mask) { return mask == 0 || (feature->flags & mask) != 0; }

// The property or reference of that name, of a class or of a method's parameter record.
const Meta_Feature* find_value_feature(const Meta_Record* record, const char* name)
{
    for (uint32 i = 0; i < record->num_meta_features; ++i)
    {
        const Meta_Feature* feature = record->meta_features[i];
        if (!is_method(feature) && eqi(feature->name, name))
            return feature;
    }
    return nullptr;
}

bool is_null(const Instance* instance, const Meta_Feature* feature)
{
    if (is_property(feature))
        return null_of(instance, as_property(feature)) != 0;
    const Meta_Reference* reference = as_reference(feature);
    return reference->subscript != 0 ? null_of(instance, reference) != 0 : reference_of(instance, reference) == nullptr;
}

} // namespace

int Container::convert(const Meta_Class* meta_class, uint32 mask, Ref<Instance>& instance)
{
    if (!instance)
        instance.reset(create(meta_class, false));
    nullify_properties(instance.ptr());
    const Meta_Record* record = record_of(instance.ptr());

    const uint32 size = get_size();
    for (uint32 i = 0; i < size; ++i)
    {
        String name;
        if (get_name(i, name) != 0)
        {
            ZMLR_LOG(LL_WARN, "get_name() failed: class=%s, index=%u", record->name, i);
            continue;
        }
        const Meta_Feature* feature = find_value_feature(record, name.c_str());
        if (!feature)
        {
            ZMLR_LOG(LL_WARN, "unknown feature: %s.%s", record->name, name.c_str());
            continue;
        }
        if (!selected(feature, mask))
            continue;
        const Value::Type type = type_of(feature);
        if (type == Value::NONE)
        {
            ZMLR_LOG(LL_WARN, "unexpected error: %s.%s", record->name, name.c_str());
            continue;
        }
        Value value;
        if (get_value(i, type, value) != 0 || value.get(instance.ptr(), feature) != 0)
            ZMLR_LOG(LL_WARN, "conversion error: %s.%s", record->name, name.c_str());
    }
    return 0;
}

int Container::convert(const Instance* instance, uint32 mask)
{
    if (!instance)
    {
        ZMLR_LOG(LL_WARN, "ignored null instance arg");
        return -1;
    }
    const Meta_Record* record = record_of(instance);

    for (uint32 i = 0; i < record->num_meta_features; ++i)
    {
        const Meta_Feature* feature = record->meta_features[i];
        if (!selected(feature, mask) || is_method(feature) || is_null(instance, feature))
            continue;
        Value value;
        if (value.set(instance, feature) != 0)
        {
            ZMLR_LOG(LL_WARN, "unexpected failure: %s.%s", record->name, feature->name);
            continue;
        }
        if (set_value(feature->name, value, feature->flags) != 0)
            ZMLR_LOG(LL_WARN, "conversion error: %s.%s", record->name, feature->name);
    }
    return 0;
}

} // namespace zmlr
