// Value: a tagged holder of one value of any CIM type, scalar or array, or of an instance.
#pragma once

#include "runtime/array.h"
#include "runtime/instance.h"
#include "runtime/types.h"

#include <concepts>
#include <cstdio>

namespace zmlr
{

class Value
{
public:
    // A scalar's code is its Type, an array's code is its element's plus 128. The scalars have the names of their Type.
#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wshadow"
    enum Type : sint32
    {
        NONE = -1,
        BOOLEAN = 0,
        UINT8,
        SINT8,
        UINT16,
        SINT16,
        UINT32,
        SINT32,
        UINT64,
        SINT64,
        REAL32,
        REAL64,
        CHAR16,
        STRING,
        DATETIME,
        INSTANCE,
        BOOLEAN_ARRAY = 128,
        UINT8_ARRAY,
        SINT8_ARRAY,
        UINT16_ARRAY,
        SINT16_ARRAY,
        UINT32_ARRAY,
        SINT32_ARRAY,
        UINT64_ARRAY,
        SINT64_ARRAY,
        REAL32_ARRAY,
        REAL64_ARRAY,
        CHAR16_ARRAY,
        STRING_ARRAY,
        DATETIME_ARRAY,
        INSTANCE_ARRAY
    };
#pragma GCC diagnostic pop

    Value() = default;     // NONE and null
    Value(const Value& x); // holds a copy, also of what x only borrows
    Value(Value&& x) noexcept;
    Value& operator=(Value x) noexcept;
    ~Value() { drop(); }

    Type type() const { return _type; }
    bool null() const { return _null; }
    void null(bool flag) { _null = flag; }
    void clear() noexcept // back to NONE and null; unrefs the instances held
    {
        drop();
        _type = NONE;
        _null = true;
        _owned = true;
        _elsewhere = nullptr;
    }

    // Takes a copy of x, sets the type and makes the value non-null. An Instance* is stored as it is: the value then owns
    // one reference to it, as it does to each element of an instance array.
    // clang-format off
    template <class T>
        requires(!(std::convertible_to<T, const Instance*> || std::convertible_to<T, const char*>))
    void set_value(const T& x) { hold(code_of<T>, &x); }
    // clang-format on
    template <class T> void set_value(Array<T>&& x) { hold_moved(code_of<Array<T>>, &x); } // the elements move in
    void set_value(Instance* x) { hold(INSTANCE, &x); }
    void set_value(const char* text) { set_value(String(text)); }

    // Copies the content out: 0, or -1 when x's type is not exactly the value's type. Instances are borrowed: they get no
    // further reference.
    template <class T> int get_value(T& x) const
    {
        const T* content = get_if<T>();
        if (!content)
            return -1;
        x = *content;
        return 0;
    }

    // The content (borrowed), or null when T is not exactly the value's type.
    template <class T> const T* get_if() const { return _type == code_of<T> ? static_cast<const T*>(content()) : nullptr; }

    // A null value of the given type (NONE: as clear()).
    void set_null(Type type);

    // Loads a property or reference of an instance (one more reference to each instance loaded): 0, or -1 for a method.
    int set(const Instance* instance, const Meta_Feature* feature);

    // The same without a copy: the value reads the instance's own, and is good for as long as that one stays as it is. (The
    // instance is not one that the value itself holds.)
    int borrow(const Instance* instance, const Meta_Feature* feature);

    // The same of a property, known not to be null, that lies there.
    void borrow(Type type, const void* place) noexcept
    {
        drop();
        _type = type;
        _null = false;
        _owned = false;
        _elsewhere = place;
    }

    // Stores the value into a property or reference; -1 and a warning when instance, type or referenced class do not fit. An
    // instance stored gets one more reference; a null value unsets a reference.
    int get(Instance* instance, const Meta_Feature* feature) const;

    // The same, but the content moves into the instance, and what was there before into the value.
    int give(Instance* instance, const Meta_Feature* feature);

    // Writes the debug text: type, null flag and what is held, as a block.
    void fprint(std::FILE* stream) const;
    void print() const; // to standard output

    static constexpr Type array_of(Type scalar) { return static_cast<Type>(scalar + 128); }

private:
    // The code of the type that a C++ type holds.
    template <class T> struct Code
    {
        static constexpr Type value = static_cast<Type>(type_code<T>::value);
    };
    template <class T> static constexpr Type code_of = Code<T>::value;

    const void* content() const { return _elsewhere ? _elsewhere : _held; }
    void drop() noexcept
    {
        if (_owned && _type != NONE)
            release();
    }
    void release() noexcept;             // what is held
    void hold(Type type, const void* x); // a copy of what lies there (null: the type's zero)
    void hold_moved(Type type, void* array);
    void construct(Type type, const void* x);
    void swap(Value& x) noexcept;

    Type _type = NONE;
    bool _null = true;
    bool _owned = true;                         // the content is to be released
    const void* _elsewhere = nullptr;           // where the content lies when it is not held
    alignas(void*) unsigned char _held[8] = {}; // every scalar, and the one handle of everything else
};

template <> struct Value::Code<Instance*>
{
    static constexpr Type value = INSTANCE;
};

template <class T> struct Value::Code<Array<T>>
{
    static constexpr Type value = array_of(Code<T>::value);
};

Value::Type type_of(const Meta_Feature* feature); // NONE for a method
inline Value::Type type_of(const Meta_Property* property)
{
    const auto scalar = static_cast<Value::Type>(property->type);
    return property->subscript != 0 ? Value::array_of(scalar) : scalar;
}
const char* name_of(Value::Type type);    // "none", "boolean" ... "instance", "boolean_array" ... "instance_array"
const char* _type_name(Value::Type type); // "NONE", "BOOLEAN" ... "INSTANCE_ARRAY"

} // namespace zmlr
