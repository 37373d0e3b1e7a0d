// Value: a tagged holder of one value of any CIM type, scalar or array, or of an instance.
#pragma once

#include "runtime/array.h"
#include "runtime/instance.h"
#include "runtime/types.h"

#include <concepts>
#include <cstdio>
#include <utility>
#include <variant>

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

    Value() = default; // NONE and null
    Value(const Value& x);
    Value(Value&& x) noexcept;
    Value& operator=(Value x) noexcept;
    ~Value() { clear(); }

    Type type() const { return _type; }
    bool null() const { return _null; }
    void null(bool flag) { _null = flag; }
    void clear() noexcept; // back to NONE and null; unrefs the instances held

    // Takes a copy of x, sets the type and makes the value non-null. An Instance* is stored as it is: the value then owns
    // one reference to it, as it does to each element of an instance array.
    // clang-format off
    template <class T>
        requires(!(std::convertible_to<T, const Instance*> || std::convertible_to<T, const char*>))
    void set_value(const T& x) { adopt(Content(std::in_place_type<T>, x)); }
    // clang-format on
    void set_value(Instance* x) { adopt(Content(x)); }
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
    template <class T> const T* get_if() const { return std::get_if<T>(&_content); }

    // A null value of the given type (NONE: as clear()).
    void set_null(Type type);

    // Loads a property or reference of an instance (one more reference to each instance loaded): 0, or -1 for a method.
    int set(const Instance* instance, const Meta_Feature* feature);

    // Stores the value into a property or reference; -1 and a warning when instance, type or referenced class do not fit. An
    // instance stored gets one more reference; a null value unsets a reference.
    int get(Instance* instance, const Meta_Feature* feature) const;

    // Writes the debug text: type, null flag and what is held, as a block.
    void fprint(std::FILE* stream) const;
    void print() const; // to standard output

    static constexpr Type array_of(Type scalar) { return static_cast<Type>(scalar + 128); }

private:
    // The alternatives stand in the order of the type codes, scalars first.
    using Content = std::variant<std::monostate, boolean, uint8, sint8, uint16, sint16, uint32, sint32, uint64, sint64, real32,
                                 real64, char16, String, Datetime, Instance*, Array<boolean>, Array<uint8>, Array<sint8>,
                                 Array<uint16>, Array<sint16>, Array<uint32>, Array<sint32>, Array<uint64>, Array<sint64>,
                                 Array<real32>, Array<real64>, Array<char16>, Array<String>, Array<Datetime>, Array<Instance*>>;
    friend struct Value_Access;

    void adopt(Content&& content) noexcept;

    Type _type = NONE;
    bool _null = true;
    Content _content;
};

Value::Type type_of(const Meta_Feature* feature); // NONE for a method
const char* name_of(Value::Type type);            // "none", "boolean" ... "instance", "boolean_array" ... "instance_array"
const char* _type_name(Value::Type type);         // "NONE", "BOOLEAN" ... "INSTANCE_ARRAY"

} // namespace zmlr
