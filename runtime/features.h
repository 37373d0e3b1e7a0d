// How generic code walks the features of a record and checks the instances it is given: for the sources of runtime/, for the
// conversion of cmpi/ and for tests; whoever knows the class of an instance reads its fields.
#pragma once

#include "runtime/assert.h"
#include "runtime/instance.h"

#include <span>

namespace zmlr
{

inline std::span<const Meta_Feature* const> features_of(const Meta_Record* record)
{
    return {record->meta_features, record->num_meta_features};
}

inline std::span<const Meta_Feature* const> features_of(const Instance* instance) { return features_of(record_of(instance)); }

inline bool is_array(const Meta_Property* property) { return property->subscript != 0; }
inline bool is_array(const Meta_Reference* reference) { return reference->subscript != 0; }

// A property or reference when the feature is one of that kind, else null.
inline const Meta_Property* to_property(const Meta_Feature* feature)
{
    return is_property(feature) ? as_property(feature) : nullptr;
}
inline const Meta_Reference* to_single_reference(const Meta_Feature* feature)
{
    return is_reference(feature) && !is_array(as_reference(feature)) ? as_reference(feature) : nullptr;
}
inline const Meta_Reference* to_array_reference(const Meta_Feature* feature)
{
    return is_reference(feature) && is_array(as_reference(feature)) ? as_reference(feature) : nullptr;
}

// The value at an offset, which must hold a T.
template <class T> T& value_at(Instance* instance, uint32 offset) { return *static_cast<T*>(address_of(instance, offset)); }
template <class T> const T& value_at(const Instance* instance, uint32 offset)
{
    return *static_cast<const T*>(address_of(instance, offset));
}

inline Array<Instance*>& references_of(Instance* instance, const Meta_Reference* array_reference)
{
    return value_at<Array<Instance*>>(instance, array_reference->offset);
}
inline const Array<Instance*>& references_of(const Instance* instance, const Meta_Reference* array_reference)
{
    return value_at<Array<Instance*>>(instance, array_reference->offset);
}

// Whether a property, a reference or an array of references has no value. Every walk over an instance asks it of every feature.
inline bool is_null(const Instance* instance, const Meta_Feature* feature)
{
    if (const Meta_Property* property = to_property(feature))
        return null_of(instance, property) != 0;
    const Meta_Reference* reference = as_reference(feature);
    return is_array(reference) ? null_of(instance, reference) != 0 : !reference_of(instance, reference);
}

// Whether the value of a feature is more than the bytes of a number.
inline bool takes_memory(const Meta_Feature* feature)
{
    const Meta_Property* property = to_property(feature);
    return !property || is_array(property) || property->type == STRING || property->type == DATETIME;
}

// A new record of a class or a method: null flags clear, values zero, references unset.
Instance* create_record(const Meta_Record* record);

// Ends the value of a property: it is that of a new record.
void end_value(Instance* instance, const Meta_Property* property);

// Copies one feature between instances of one class; a reference gets a clone of the source's.
void copy_feature(Instance* dest, const Instance* src, const Meta_Feature* feature);

// Fails with one of the two texts unless the instance is there and valid; the report names the caller's place.
inline void check_instance(const Instance* instance, const char* present, const char* valid, const char* file = __builtin_FILE(),
                           int line = __builtin_LINE(), const char* function = __builtin_FUNCTION())
{
    check(instance != nullptr, present, file, line, function);
    check(instance->__magic == CIMPLE_INSTANCE_MAGIC, valid, file, line, function);
}

inline void check_inst(const Instance* inst, const char* file = __builtin_FILE(), int line = __builtin_LINE(),
                       const char* function = __builtin_FUNCTION())
{
    check_instance(inst, "inst != 0", "inst->__magic == CIMPLE_INSTANCE_MAGIC", file, line, function);
}

} // namespace zmlr
