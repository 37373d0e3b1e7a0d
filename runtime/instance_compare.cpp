#include "runtime/features.h"

#include <algorithm>
#include <cstring>

namespace zmlr
{

namespace
{

// Two properties of the same type and subscript, perhaps at different places of different classes.
bool value_eq(const Meta_Property* p1, const Instance* i1, const Meta_Property* p2, const Instance* i2)
{
    if ((null_of(i1, p1) != 0) != (null_of(i2, p2) != 0))
        return false;
    if (is_array(p1))
        return __equal(value_at<const __Array_Rep*>(i1, p1->offset), value_at<const __Array_Rep*>(i2, p2->offset));

    const void* v1 = address_of(i1, p1->offset);
    const void* v2 = address_of(i2, p2->offset);
    const __Array_Traits& traits = __cim_array_traits[p1->type];
    return traits.equal ? traits.equal(v1, v2, 1) : std::memcmp(v1, v2, traits.elem_size) == 0;
}

bool both_null_or(bool (*equal)(const Instance*, const Instance*), const Instance* i1, const Instance* i2)
{
    return i1 && i2 ? equal(i1, i2) : i1 == i2;
}

bool feature_identical(const Meta_Feature* feature, const Instance* i1, const Instance* i2)
{
    if (const Meta_Property* property = to_property(feature))
        return value_eq(property, i1, property, i2);
    if (const Meta_Reference* single = to_single_reference(feature))
        return both_null_or(identical, reference_of(i1, single), reference_of(i2, single));

    const Meta_Reference* array = to_array_reference(feature);
    if (!array)
        return true;
    const Array<Instance*>& a1 = references_of(i1, array);
    const Array<Instance*>& a2 = references_of(i2, array);
    return (null_of(i1, array) != 0) == (null_of(i2, array) != 0) &&
           std::equal(a1.begin(), a1.end(), a2.begin(), a2.end(),
                      [](const Instance* e1, const Instance* e2) { return both_null_or(identical, e1, e2); });
}

bool key_property_eq(const Meta_Property* p1, const Instance* i1, const Instance* i2)
{
    const Meta_Property* p2 = i1->meta_class == i2->meta_class ? p1 : find_property(i2->meta_class, p1->name);
    return p2 && is_key(p2) && p1->type == p2->type && p1->subscript == p2->subscript && value_eq(p1, i1, p2, i2);
}

bool key_reference_eq(const Meta_Reference* r1, const Instance* i1, const Instance* i2)
{
    const Meta_Reference* r2 = i1->meta_class == i2->meta_class ? r1 : find_reference(i2->meta_class, r1->name);
    return r2 && is_key(r2) && !is_array(r2) &&
           (is_subclass(r1->meta_class, r2->meta_class) || is_subclass(r2->meta_class, r1->meta_class)) &&
           both_null_or(key_eq, reference_of(i1, r1), reference_of(i2, r2));
}

bool key_feature_eq(const Meta_Feature* feature, const Instance* i1, const Instance* i2)
{
    if (const Meta_Property* property = to_property(feature))
        return key_property_eq(property, i1, i2);
    const Meta_Reference* reference = to_single_reference(feature);
    return !reference || key_reference_eq(reference, i1, i2);
}

void check_pair(const Instance* i1, const Instance* i2, const char* file = __builtin_FILE(), int line = __builtin_LINE(),
                const char* function = __builtin_FUNCTION())
{
    check_instance(i1, "i1 != 0", "i1->__magic == CIMPLE_INSTANCE_MAGIC", file, line, function);
    check_instance(i2, "i2 != 0", "i2->__magic == CIMPLE_INSTANCE_MAGIC", file, line, function);
}

} // namespace

bool property_eq(const Meta_Property* property, const Instance* i1, const Instance* i2)
{
    check_pair(i1, i2);
    return value_eq(property, i1, property, i2);
}

bool identical(const Instance* i1, const Instance* i2)
{
    check_pair(i1, i2);
    return i1->meta_class == i2->meta_class && i1->__name_space == i2->__name_space &&
           std::ranges::all_of(features_of(i1), [=](const Meta_Feature* f) { return feature_identical(f, i1, i2); });
}

bool key_eq(const Instance* i1, const Instance* i2)
{
    check_pair(i1, i2);
    return std::ranges::all_of(features_of(i1), [=](const Meta_Feature* f) { return !is_key(f) || key_feature_eq(f, i1, i2); });
}

} // namespace zmlr
