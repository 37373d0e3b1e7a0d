#include "runtime/features.h"

#include <algorithm>

namespace zmlr
{

namespace
{

void mark_wanted(Instance* instance, const Meta_Feature* feature)
{
    if (const Meta_Property* property = to_property(feature))
    {
        null_of(instance, property) = 0;
    }
    else if (const Meta_Reference* single = to_single_reference(feature))
    {
        Instance*& slot = reference_of(instance, single);
        if (!slot)
            slot = create(single->meta_class, false);
    }
    else if (const Meta_Reference* array = to_array_reference(feature))
    {
        null_of(instance, array) = 0;
    }
}

bool key_non_null(const Instance* instance, const Meta_Feature* feature)
{
    if (const Meta_Property* property = to_property(feature))
        return !null_of(instance, property);
    const Meta_Reference* reference = to_single_reference(feature);
    return !reference || reference_of(instance, reference);
}

} // namespace

void __set_null_flags(Instance* instance, bool keys, bool non_keys, uint8 value)
{
    check_inst(instance);
    for (const Meta_Feature* feature : features_of(instance))
        if (is_property(feature) && (is_key(feature) ? keys : non_keys))
            null_of(instance, as_property(feature)) = value;
}

void nullify_properties(Instance* instance) { __set_null_flags(instance, true, true, 1); }
void nullify_non_keys(Instance* instance) { __set_null_flags(instance, false, true, 1); }
void de_nullify_properties(Instance* instance) { __set_null_flags(instance, true, true, 0); }

bool keys_non_null(const Instance* instance)
{
    check_inst(instance);
    return std::ranges::all_of(features_of(instance),
                               [=](const Meta_Feature* f) { return !is_key(f) || key_non_null(instance, f); });
}

int filter_properties(Instance* instance, const char* const* names, bool keep_keys)
{
    if (!names)
    {
        de_nullify_properties(instance);
        return 0;
    }

    __set_null_flags(instance, !keep_keys, true, 1);
    for (; *names; ++names)
    {
        const Meta_Feature* feature = find_feature(instance->meta_class, *names);
        if (!feature || is_key(feature))
            continue;
        if (is_method(feature))
            return -1;
        mark_wanted(instance, feature);
    }
    return 0;
}

void __create_refs(Instance* instance)
{
    check_inst(instance);
    for (const Meta_Feature* feature : features_of(instance))
    {
        const Meta_Reference* reference = to_single_reference(feature);
        if (reference && !reference_of(instance, reference))
            reference_of(instance, reference) = create(reference->meta_class, true);
    }
}

} // namespace zmlr
