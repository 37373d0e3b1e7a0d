// Class meta-data: the read-only records that describe every CIM class, its features and their place in an instance.
//
// Plain records without functions of the runtime behind them: the embedded CIM server reads them too, through
// cimple_module(), to answer class operations. All of them are generated as constant data.
#pragma once

#include "runtime/atomic.h"
#include "runtime/types.h"

namespace zmlr
{

// Flags of classes and features. A feature's kind is bit 0, 1 or 2; a key is marked by Flag_Key and by nothing else.
enum Flags : uint32
{
    Flag_Property = 0x00000001,
    Flag_Reference = 0x00000002,
    Flag_Method = 0x00000004,
    Flag_Class = 0x00000008,
    Flag_Abstract = 0x00000010,
    Flag_Aggregate = 0x00000020,
    Flag_Aggregation = 0x00000040,
    Flag_Association = 0x00000080,
    Flag_Composition = 0x00000100,
    Flag_Counter = 0x00000200,
    Flag_Delete = 0x00000400,
    Flag_DN = 0x00000800,
    Flag_EmbeddedObject = 0x00001000,
    Flag_Exception = 0x00002000,
    Flag_Expensive = 0x00004000,
    Flag_Experimental = 0x00008000,
    Flag_Gauge = 0x00010000,
    Flag_IfDeleted = 0x00020000,
    Flag_In = 0x00040000,
    Flag_Indication = 0x00080000,
    Flag_Invisible = 0x00100000,
    Flag_Key = 0x00200000,
    Flag_Large = 0x00400000,
    Flag_OctetString = 0x00800000,
    Flag_Out = 0x01000000,
    Flag_Read = 0x02000000,
    Flag_Required = 0x04000000,
    Flag_Static = 0x08000000,
    Flag_Terminal = 0x10000000,
    Flag_Weak = 0x20000000,
    Flag_Write = 0x40000000,
    Flag_EmbeddedInstance = 0x80000000
};

inline constexpr uint32 num_flag_names = 32;
extern const char* const flag_names[num_flag_names]; // the name of bit i stands at index i

struct Meta_Class;
struct Meta_Repository;

struct Meta_Qualifier
{
    Atomic refs;
    const char* name;
    uint8 type;
    uint8 subscript;
    uint16 flavors;
    const void* value;
};

// The head that properties, references, methods and classes share; find out which one it is from `flags`.
struct Meta_Feature
{
    Atomic refs; // 0: static, never counted or freed
    uint32 flags;
    const char* name;
    const Meta_Qualifier* const* meta_qualifiers;
    uint32 num_meta_qualifiers;
};

// A default. Scalar: `data` points at the value's bytes (for STRING and DATETIME at the text). Array: at the first of
// `size` elements (for STRING and DATETIME at an array of texts).
struct Meta_Value
{
    const void* data;
    uint32 size; // elements of an array, 1 for a scalar
};

struct Meta_Property : Meta_Feature
{
    uint16 type;      // Type
    sint16 subscript; // 0 scalar, -1 array of any length, n > 0 array of n
    uint32 offset;    // bytes from the instance's address
    const Meta_Value* value;
};

struct Meta_Reference : Meta_Feature
{
    uint16 subscript; // 0 one reference, else an array
    const Meta_Class* meta_class;
    uint32 offset;
};

// What describes the layout of a record in memory: a class of its instances, a method of its parameter records.
struct Meta_Record : Meta_Feature
{
    const Meta_Feature* const* meta_features;
    uint32 num_meta_features;
    uint32 size; // bytes of one record
};

// A method: its features are the parameters in declaration order, the last one "return_value" (a Flag_Out property).
struct Meta_Method : Meta_Record
{
    uint16 return_type; // Type
};

struct Meta_Feature_Local
{
    uint8 local; // 1 when the class itself declares or overrides the feature
};

// A class: its features are the inherited ones first, root class down, an override in its ancestor's place.
struct Meta_Class : Meta_Record
{
    const Meta_Feature_Local* locals;   // one per feature
    const Meta_Class* super_meta_class; // null at the root
    uint32 num_keys;
    const Meta_Repository* meta_repository;
};

struct Meta_Repository
{
    const Meta_Class* const* meta_classes;
    uint32 num_meta_classes;
};

inline bool is_property(const Meta_Feature* feature) { return (feature->flags & Flag_Property) != 0; }
inline bool is_reference(const Meta_Feature* feature) { return (feature->flags & Flag_Reference) != 0; }
inline bool is_method(const Meta_Feature* feature) { return (feature->flags & Flag_Method) != 0; }
inline bool is_key(const Meta_Feature* feature) { return (feature->flags & Flag_Key) != 0; }

inline const Meta_Property* as_property(const Meta_Feature* feature) { return static_cast<const Meta_Property*>(feature); }
inline const Meta_Reference* as_reference(const Meta_Feature* feature) { return static_cast<const Meta_Reference*>(feature); }
inline const Meta_Method* as_method(const Meta_Feature* feature) { return static_cast<const Meta_Method*>(feature); }

// Look-up; names are compared without regard to case. Each returns null (or the stated value) when nothing matches.
const Meta_Class* find_meta_class(const Meta_Repository* repository, const char* name);
const Meta_Class* find_meta_class(const Meta_Class* meta_class, const char* name); // itself, an ancestor, or its repository
bool is_subclass(const Meta_Class* ancestor, const Meta_Class* descendant);
const Meta_Feature* find_feature(const Meta_Record* record, const char* name,
                                 uint32 kind_mask = Flag_Property | Flag_Reference | Flag_Method);
const Meta_Property* find_property(const Meta_Class* meta_class, const char* name);
const Meta_Reference* find_reference(const Meta_Class* meta_class, const char* name);
const Meta_Method* find_method(const Meta_Class* meta_class, const char* name);
const Meta_Feature* find_parameter(const Meta_Method* meta_method, const char* name,
                                   uint32 kind_mask = Flag_Property | Flag_Reference);
const Meta_Reference* find_reference(const Meta_Method* meta_method, const char* name);
uint32 flag_name_to_index(const char* name); // the bit of a flag name, 0xFFFFFFFF when unknown

// Whether any feature has a flag of the mask. (The name with leading underscores is a builtin of clang.)
bool has_feature(const Meta_Class* meta_class, uint32 kind_mask);

// Counts leave a static class alone. A class made at run time comes from `new` with a count of 1: the last unref deletes the
// record; what it points to is its maker's, and must live as long.
void ref(const Meta_Class* meta_class);
void unref(const Meta_Class* meta_class);

} // namespace zmlr
