#include "runtime/instance.h"

#include "runtime/features.h"

#include <cstring>
#include <memory>
#include <new>

namespace zmlr
{

namespace
{

constexpr int freed_byte = 0xDD;

// A reference field of a record holds a pointer to the record type of its class.
using Reference_Slot [[gnu::may_alias]] = Instance*;

const __Array_Traits* traits_of(const Meta_Property* property) { return &__cim_array_traits[property->type]; }

// Makes a feature of a zeroed record. Nothing here allocates.
void construct(Instance* instance, const Meta_Feature* feature)
{
    if (const Meta_Property* property = to_property(feature))
    {
        void* value = address_of(instance, property->offset);
        if (is_array(property))
            __construct(*static_cast<__Array_Rep**>(value), traits_of(property));
        else if (property->type == STRING)
            new (value) String;
        else if (property->type == DATETIME)
            new (value) Datetime;
    }
    else if (const Meta_Reference* reference = to_array_reference(feature))
    {
        new (address_of(instance, reference->offset)) Array<Instance*>;
        null_of(instance, reference) = 1;
    }
}

void destruct(Instance* instance, const Meta_Feature* feature)
{
    if (const Meta_Property* property = to_property(feature))
    {
        if (is_array(property))
            __destruct(value_at<__Array_Rep*>(instance, property->offset));
        else if (property->type == STRING)
            std::destroy_at(&value_at<String>(instance, property->offset));
        else if (property->type == DATETIME)
            std::destroy_at(&value_at<Datetime>(instance, property->offset));
    }
    else if (const Meta_Reference* single = to_single_reference(feature))
    {
        unref(reference_of(instance, single));
    }
    else if (const Meta_Reference* array = to_array_reference(feature))
    {
        for (Instance* element : references_of(instance, array))
            unref(element);
        std::destroy_at(&references_of(instance, array));
    }
}

void free_record(Instance* instance)
{
    for (const Meta_Feature* feature : features_of(instance))
        if (takes_memory(feature))
            destruct(instance, feature);

    const std::size_t size = record_of(instance)->size;
    unref(instance->meta_class);
    std::destroy_at(&instance->__name_space);
    std::memset(static_cast<void*>(instance), freed_byte, size);
    __asm__ volatile("" : : "r"(instance) : "memory"); // the mark must reach memory although the record ends here
    ::operator delete(instance);
}

void set_default(Instance* instance, const Meta_Property* property)
{
    const Meta_Value& from = *property->value;
    if (is_array(property) && (property->type == STRING || property->type == DATETIME))
    {
        for (const char* text : std::span(static_cast<const char* const*>(from.data), from.size))
        {
            if (property->type == STRING)
                value_at<Array<String>>(instance, property->offset).append(String(text));
            else
                value_at<Array<Datetime>>(instance, property->offset).append(Datetime(text));
        }
    }
    else if (is_array(property))
        __append(value_at<__Array_Rep*>(instance, property->offset), from.data, from.size);
    else if (property->type == STRING)
        value_at<String>(instance, property->offset) = static_cast<const char*>(from.data);
    else if (property->type == DATETIME)
        value_at<Datetime>(instance, property->offset).set(static_cast<const char*>(from.data));
    else
        std::memcpy(address_of(instance, property->offset), from.data, type_size[property->type]);
}

void set_defaults(Instance* instance)
{
    for (const Meta_Feature* feature : features_of(instance))
    {
        const Meta_Property* property = to_property(feature);
        if (property && property->value)
            set_default(instance, property);
        else if (property)
            null_of(instance, property) = 1;
    }
}

} // namespace

constinit const Meta_Class Instance::static_meta_class = {
    {{{0}, Flag_Class, "Instance", nullptr, 0}, nullptr, 0, sizeof(Instance)}, nullptr, nullptr, 0, nullptr};

Instance*& reference_of(Instance* instance, const Meta_Reference* reference)
{
    return value_at<Reference_Slot>(instance, reference->offset);
}

const Instance* reference_of(const Instance* instance, const Meta_Reference* reference)
{
    return value_at<Reference_Slot>(instance, reference->offset);
}

Instance* create_record(const Meta_Record* record)
{
    auto* instance = static_cast<Instance*>(::operator new(record->size));
    std::memset(static_cast<void*>(instance), 0, record->size);
    instance->__magic = CIMPLE_INSTANCE_MAGIC;
    Atomic_create(&instance->__refs, 1);
    instance->meta_class = reinterpret_cast<const Meta_Class*>(record);
    ref(instance->meta_class);
    new (&instance->__name_space) String;

    for (const Meta_Feature* feature : features_of(record))
        if (takes_memory(feature))
            construct(instance, feature);
    return instance;
}

Instance* create(const Meta_Class* meta_class, bool defaults)
{
    check(meta_class != nullptr, "meta_class != 0");
    Ref<Instance> instance(create_record(meta_class));
    if (defaults)
        set_defaults(instance.ptr());
    return instance.steal();
}

Instance* create(const Meta_Method* meta_method)
{
    check(meta_method != nullptr, "meta_method != 0");
    return create_record(meta_method);
}

void destroy(Instance* instance)
{
    check_inst(instance);
    check(Atomic_get(&instance->__refs) == 1, "Atomic_get(&inst->__refs) == 1");
    free_record(instance);
}

void ref(const Instance* instance)
{
    if (!instance)
        return;
    check_inst(instance);
    Atomic_inc(&const_cast<Instance*>(instance)->__refs);
}

bool is_shared(const Instance* instance) { return instance && Atomic_get(&instance->__refs) > 1; }

void end_value(Instance* instance, const Meta_Property* property)
{
    destruct(instance, property);
    construct(instance, property);
}

void unref(const Instance* instance)
{
    if (!instance)
        return;
    check_inst(instance);
    auto* owned = const_cast<Instance*>(instance);
    if (Atomic_dec_and_test(&owned->__refs))
        free_record(owned);
}

} // namespace zmlr
