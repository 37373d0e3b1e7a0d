// Instance: the common head of every CIM object record, and the generic operations that work on any record through its
// meta-data: life, copies, comparison, null handling, association helpers, name spaces.
//
// Instances are reference counted; whoever creates one owns its one reference and passes it on when handing it over. A
// reference field owns one reference to its target. Counts are atomic, contents are not locked: an instance that threads
// share is read only. A null or broken instance given to any operation is an internal-consistency failure.
#pragma once

#include "runtime/array.h"
#include "runtime/atomic.h"
#include "runtime/meta.h"
#include "runtime/property.h"
#include "runtime/string.h"

#include <utility>

namespace zmlr
{

inline constexpr uint32 CIMPLE_INSTANCE_MAGIC = 0xF00DFACE;

// The generated record types derive from this head; their features follow it.
struct Instance
{
    uint32 __magic;
    Atomic __refs;
    const Meta_Class* meta_class; // of a method's parameter record: its Meta_Method (see record_of)
    String __name_space;

    static const Meta_Class static_meta_class; // the root: every class counts as a subclass of it
};

// The layout part of an instance's meta-data, valid for objects and parameter records alike.
inline const Meta_Record* record_of(const Instance* instance) { return instance->meta_class; }

// Locating a value. Generic code reads and writes values only this way.
inline void* address_of(Instance* instance, uint32 offset) { return reinterpret_cast<char*>(instance) + offset; }
inline const void* address_of(const Instance* instance, uint32 offset)
{
    return reinterpret_cast<const char*>(instance) + offset;
}
inline uint32 type_size_of(const Meta_Property* property) // bytes of the value: a scalar's or an array handle's
{
    return property->subscript != 0 ? uint32{sizeof(void*)} : type_size[property->type];
}
inline uint8& null_of(Instance* instance, const Meta_Property* property)
{
    return *static_cast<uint8*>(address_of(instance, property->offset + type_size_of(property)));
}
inline uint8 null_of(const Instance* instance, const Meta_Property* property)
{
    return null_of(const_cast<Instance*>(instance), property);
}
inline uint8& null_of(Instance* instance, const Meta_Reference* array_reference) // arrays of references only
{
    return *static_cast<uint8*>(address_of(instance, array_reference->offset + uint32{sizeof(void*)}));
}
inline uint8 null_of(const Instance* instance, const Meta_Reference* array_reference)
{
    return null_of(const_cast<Instance*>(instance), array_reference);
}
Instance*& reference_of(Instance* instance, const Meta_Reference* reference); // single references only
const Instance* reference_of(const Instance* instance, const Meta_Reference* reference);

// Life. create() with defaults: a property with a default has it, every other one is null; without: every property is
// non-null and zero. References start unset. destroy() is legal only while the count is exactly 1.
Instance* create(const Meta_Class* meta_class, bool defaults);
Instance* create(const Meta_Method* meta_method);
void destroy(Instance* instance);
void ref(const Instance* instance);       // null is ignored
void unref(const Instance* instance);     // null is ignored; destroys at zero
bool is_shared(const Instance* instance); // held by more than one reference; null is not
Instance* clone(const Instance* instance);
Instance* key_clone(const Instance* instance); // keys copied, everything else null

template <class T> T* create(bool defaults = true) { return static_cast<T*>(create(&T::static_meta_class, defaults)); }
template <class T> T* clone(const T* instance) { return static_cast<T*>(clone(static_cast<const Instance*>(instance))); }

// The instance as a T, or null when its class is not T or a subclass of T (or it is null).
template <class T> T* cast(Instance* instance)
{
    return instance && is_subclass(&T::static_meta_class, instance->meta_class) ? static_cast<T*>(instance) : nullptr;
}
template <class T> const T* cast(const Instance* instance) { return cast<T>(const_cast<Instance*>(instance)); }

// Copies between instances of one class: null flags and values; a reference is replaced by a clone of the source's. When memory
// runs out on the way (std::bad_alloc), the features before are copied already and the others are as they were.
void copy(Instance* dest, const Instance* src);
void copy(Instance* dest, const Instance* src, const Instance* model); // only what is non-null in the model
void copy_keys(Instance* dest, const Instance* src);
void clear(Instance* instance);

// Comparison.
bool property_eq(const Meta_Property* property, const Instance* a, const Instance* b);
bool identical(const Instance* a, const Instance* b);
bool key_eq(const Instance* a, const Instance* b); // subclass and class may be equal; only keys count

// Null handling. filter_properties marks what a caller asked for: names is a null-terminated list (null: everything is
// non-null); keys stay as they are with keep_keys. It returns -1 when a name denotes a method, else 0.
void __set_null_flags(Instance* instance, bool keys, bool non_keys, uint8 value);
void nullify_properties(Instance* instance);
void nullify_non_keys(Instance* instance);
void de_nullify_properties(Instance* instance);
bool keys_non_null(const Instance* instance);
int filter_properties(Instance* instance, const char* const* names, bool keep_keys);
void __create_refs(Instance* instance);

// Associations. get_associators writes the far ends of an association that concerns `instance` to `out` (room for one
// entry per reference of the association's class; the entries are borrowed) and returns their number, or -1 when the
// association does not concern the instance in that role; entries written all the same are of no use then.
int get_associators(const Instance* instance, const Instance* association, const char* result_class, const char* role,
                    const char* result_role, const Instance** out);
bool is_reference_of(const Instance* instance, const Instance* association, const char* role);

// Name spaces: the instance and, depth first, everything it references.
void __visit(Instance* instance, void (*callback)(Instance* instance, void* data), void* data);
void __set_name_space_recursive(Instance* instance, const String& name_space, bool force);

// One counted reference to an instance.
template <class T> class Ref
{
public:
    Ref() = default;
    explicit Ref(T* instance) : _ptr(instance) {} // adopts
    Ref(const Ref& x) : _ptr(x._ptr) { ref(_ptr); }
    Ref(Ref&& x) noexcept : _ptr(x.steal()) {}
    ~Ref() { unref(_ptr); }

    Ref& operator=(Ref x) noexcept
    {
        std::swap(_ptr, x._ptr);
        return *this;
    }

    T* ptr() const { return _ptr; }
    T* operator->() const { return _ptr; }
    explicit operator bool() const { return _ptr != nullptr; }
    T* steal() { return std::exchange(_ptr, nullptr); }
    void reset(T* instance = nullptr) { *this = Ref(instance); }

private:
    T* _ptr = nullptr;
};

// Another reference to an instance that somebody holds.
inline Ref<Instance> share(const Instance* instance)
{
    ref(instance);
    return Ref<Instance>(const_cast<Instance*>(instance));
}

// A reference field takes a reference to the instance, which is a T or unset.
template <class T> void set_reference(T*& field, Instance* instance)
{
    ref(instance);
    unref(field);
    field = static_cast<T*>(instance);
}

// Instances that are owned together: what managers and helpers return. The elements may be null.
class Instance_Array : public Array<Instance*>
{
public:
    Instance_Array() = default;
    Instance_Array(Instance_Array&& x) noexcept = default;
    Instance_Array(const Instance_Array&) = delete;
    Instance_Array& operator=(const Instance_Array&) = delete;
    ~Instance_Array()
    {
        for (Instance* instance : *this)
            unref(instance);
    }

    // Appends an instance, or all of another array, and takes over the references.
    template <class T> void adopt(Ref<T> instance)
    {
        append(instance.ptr());
        instance.steal();
    }
    void adopt(Instance_Array&& more)
    {
        if (empty())
            return static_cast<void>(Array<Instance*>::operator=(std::move(more)));
        reserve(size() + more.size());
        for (Instance*& place : more)
        {
            append(place);
            place = nullptr;
        }
    }
};

} // namespace zmlr
