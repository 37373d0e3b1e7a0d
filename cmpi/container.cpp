#include "cmpi/container.h"

#include "runtime/features.h"
#include "runtime/log.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "Container";

bool selected(const Meta_Feature* feature, uint32 mask) { return mask == 0 || (feature->flags & mask) != 0; }

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
    if (!instance)
    {
        ZMLR_LOG(LL_WARN, "ignored null instance arg");
        return -1;
    }
    const Meta_Record* record = record_of(instance);

    // Keys stand among the first features: what follows the last of them is not looked at.
    uint32 left = mask == Flag_Key ? instance->meta_class->num_keys : record->num_meta_features;
    Value value;
    for (uint32 i = 0; i < record->num_meta_features && left > 0; ++i)
    {
        const Meta_Feature* feature = record->meta_features[i];
        if (!selected(feature, mask))
            continue;
        --left;
        if (is_method(feature) || is_null(instance, feature))
            continue;
        if (value.borrow(instance, feature) != 0)
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
