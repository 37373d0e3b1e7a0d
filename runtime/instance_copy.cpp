#include "runtime/features.h"

#include <cstring>
#include <utility>

namespace zmlr
{

namespace
{

Instance* clone_if_set(const Instance* instance) { return instance ? clone(instance) : nullptr; }

void copy_property(Instance* dest, const Instance* src, const Meta_Property* property)
{
    const uint32 offset = property->offset;
    if (is_array(property))
        __assign(value_at<__Array_Rep*>(dest, offset), value_at<const __Array_Rep*>(src, offset));
    else if (property->type == STRING)
        value_at<String>(dest, offset) = value_at<String>(src, offset);
    else if (property->type == DATETIME)
        value_at<Datetime>(dest, offset) = value_at<Datetime>(src, offset);
    else
        std::memcpy(address_of(dest, offset), address_of(src, offset), type_size[property->type]);
    null_of(dest, property) = null_of(src, property);
}

void copy_references(Instance* dest, const Instance* src, const Meta_Reference* reference)
{
    Instance_Array clones;
    for (const Instance* element : references_of(src, reference))
        clones.adopt(Ref<Instance>(clone_if_set(element)));
    std::swap(references_of(dest, reference), static_cast<Array<Instance*>&>(clones));
    null_of(dest, reference) = null_of(src, reference);
}

bool is_set(const Instance* model, const Meta_Feature* feature)
{
    if (const Meta_Property* property = to_property(feature))
        return !null_of(model, property);
    if (const Meta_Reference* single = to_single_reference(feature))
        return reference_of(model, single) != nullptr;
    if (const Meta_Reference* array = to_array_reference(feature))
        return !null_of(model, array);
    return false;
}

void check_copy(const Instance* dest, const Instance* src, const char* file = __builtin_FILE(), int line = __builtin_LINE(),
                const char* function = __builtin_FUNCTION())
{
    check_instance(dest, "dest != 0", "dest->__magic == CIMPLE_INSTANCE_MAGIC", file, line, function);
    check_instance(src, "src != 0", "src->__magic == CIMPLE_INSTANCE_MAGIC", file, line, function);
    check(dest->meta_class == src->meta_class, "dest->meta_class == src->meta_class", file, line, function);
}

void clear_property(Instance* instance, const Meta_Property* property)
{
    if (is_array(property))
        __clear(value_at<__Array_Rep*>(instance, property->offset));
    else if (property->type == STRING)
        value_at<String>(instance, property->offset).clear();
    else if (property->type == DATETIME)
        value_at<Datetime>(instance, property->offset).clear();
    else
        std::memset(address_of(instance, property->offset), 0, type_size[property->type]);
    null_of(instance, property) = 1;
}

void clear_feature(Instance* instance, const Meta_Feature* feature)
{
    if (const Meta_Property* property = to_property(feature))
    {
        clear_property(instance, property);
    }
    else if (const Meta_Reference* single = to_single_reference(feature))
    {
        unref(std::exchange(reference_of(instance, single), nullptr));
    }
    else if (const Meta_Reference* array = to_array_reference(feature))
    {
        Instance_Array released;
        std::swap(references_of(instance, array), static_cast<Array<Instance*>&>(released));
        null_of(instance, array) = 1;
    }
}

} // namespace

void copy_feature(Instance* dest, const Instance* src, const Meta_Feature* feature)
{
    if (const Meta_Property* property = to_property(feature))
    {
        copy_property(dest, src, property);
    }
    else if (const Meta_Reference* single = to_single_reference(feature))
    {
        Instance* cloned = clone_if_set(reference_of(src, single));
        unref(std::exchange(reference_of(dest, single), cloned));
    }
    else if (const Meta_Reference* array = to_array_reference(feature))
    {
        copy_references(dest, src, array);
    }
}

Instance* clone(const Instance* instance)
{
    check_inst(instance);
    Ref<Instance> result(create_record(record_of(instance)));
    result->__name_space = instance->__name_space;
    for (const Meta_Feature* feature : features_of(instance))
        copy_feature(result.ptr(), instance, feature);
    return result.steal();
}

Instance* key_clone(const Instance* instance)
{
    check_inst(instance);
    Ref<Instance> result(create_record(record_of(instance)));
    nullify_properties(result.ptr());
    copy_keys(result.ptr(), instance);
    return result.steal();
}

void copy(Instance* dest, const Instance* src)
{
    check_copy(dest, src);
    for (const Meta_Feature* feature : features_of(src))
        copy_feature(dest, src, feature);
}

void copy(Instance* dest, const Instance* src, const Instance* model)
{
    check_copy(dest, src);
    check_instance(model, "model != 0", "model->__magic == CIMPLE_INSTANCE_MAGIC");
    check(model->meta_class == dest->meta_class, "model->meta_class == dest->meta_class");
    for (const Meta_Feature* feature : features_of(src))
        if (is_set(model, feature))
            copy_feature(dest, src, feature);
}

void copy_keys(Instance* dest, const Instance* src)
{
    check_copy(dest, src);
    for (const Meta_Feature* feature : features_of(src))
        if (is_key(feature))
            copy_feature(dest, src, feature);
}

void clear(Instance* instance)
{
    check_inst(instance);
    instance->__name_space.clear();
    for (const Meta_Feature* feature : features_of(instance))
        clear_feature(instance, feature);
}

} // namespace zmlr
