// What the server knows of CIM objects: typed values, object paths and instances, free of CMPI handles and of XML.
#pragma once

#include "cimserver/model/shared.h"

#include <cmpidt.h>

#include <cstddef>
#include <cstdint>
#include <exception>
#include <initializer_list>
#include <optional>
#include <string>
#include <string_view>
#include <type_traits>
#include <utility>
#include <variant>
#include <vector>

namespace cimserver
{

struct Object_Path;
struct Instance;

// A CIM value. `type` is the CMPI type (with the array bit for an array); its content stands in the alternative that fits:
// booleans bool, unsigned integers and char16 std::uint64_t, signed integers std::int64_t, reals double, strings and
// datetimes (25-character text) Text, references and embedded instances what they say, arrays a vector of scalars.
// What is larger than a number is shared: an answer of many instances with many properties, most of them null, stays small.
struct Value
{
    using Content = std::variant<std::monostate, bool, std::uint64_t, std::int64_t, double, Text, Shared<Object_Path>,
                                 Shared<Instance>, Shared<std::vector<Value>>>;

    Value() = default;
    Value(CMPIType type_, Content content_) : content(std::move(content_)), type(type_) {}

    [[no_unique_address]] Content content; // std::monostate: null
    CMPIType type = CMPI_null;             // in the room behind the content

    bool null() const { return content.index() == 0; }

    // The content; null when it is no T.
    template <class T> const T* as() const
    {
        if constexpr (std::is_arithmetic_v<T> || std::is_same_v<T, Text>)
            return std::get_if<T>(&content);
        else
            return std::holds_alternative<Shared<T>>(content) ? &*std::get<Shared<T>>(content) : nullptr;
    }

    // The content; throws std::bad_variant_access when it is no T.
    template <class T> const T& get() const
    {
        const T* found = as<T>();
        return found ? *found : throw std::bad_variant_access();
    }
};
static_assert(sizeof(Value) == 16);

// The instances of a class hold its name and those of its properties once.
using Name = Text;

struct Named_Value
{
    Name name;
    Value value;
};

struct Object_Path
{
    Name host;
    std::string name_space;
    Name class_name;
    std::vector<Named_Value> keys;
};

// Adds a value to a list, in the place of one of the same name.
void put(std::vector<Named_Value>& list, Name name, Value value); // names.cpp

// The properties of an instance in their order. What they are called, and the values that most have (null, when they are a
// class's), stands in a list that many instances share: each holds only what differs from it. Of a class with 60 properties an
// instance has 20.
class Properties
{
public:
    using List = Shared<std::vector<Named_Value>>;

    struct Property
    {
        const Name& name;
        const Value& value;
    };

    class Iterator
    {
    public:
        Iterator(const Properties& properties, std::size_t place) : _properties(&properties), _place(place) {}
        Property operator*() const { return {(*_properties->_list)[_place].name, (*_properties)[_place]}; }
        Iterator& operator++() { return ++_place, *this; }
        bool operator==(const Iterator&) const = default;

    private:
        const Properties* _properties;
        std::size_t _place;
    };

    Properties() = default;
    Properties(std::initializer_list<Named_Value> listed) : _list(std::vector(listed)) {}
    Properties(std::vector<Named_Value> listed) : _list(std::move(listed)) {}
    explicit Properties(List list) : _list(std::move(list)) {}
    operator std::vector<Named_Value>() const;

    std::size_t size() const { return (*_list).size(); }
    bool empty() const { return size() == 0; }
    Iterator begin() const { return {*this, 0}; }
    Iterator end() const { return {*this, size()}; }
    const Value& operator[](std::size_t place) const;
    const Value* find(std::string_view name) const; // null when there is no such property

    void set(std::size_t place, Value&& value); // a null value keeps the property's type
    void put(Name name, Value value);           // sets it, or adds one at the end

private:
    // A value with its place in the list, in the room behind its type.
    struct Own : Value
    {
        Own(Value&& value, std::size_t place_) : Value(std::move(value)), place(static_cast<std::uint16_t>(place_)) {}

        std::uint16_t place;
    };
    static_assert(sizeof(Own) == sizeof(Value));

    List _list;
    std::vector<Own> _own; // in their places' order
};

struct Instance
{
    Object_Path path;
    Properties properties;
};

// A list of property names a client asked for; absent: all.
using Property_List = std::optional<std::vector<std::string>>;

// A CIM operation that failed: a CIM status code (DSP0200) and a description for people.
class Cim_Error : public std::exception
{
public:
    Cim_Error(int code, std::string description) : _code(code), _description(std::move(description)) {}
    int code() const { return _code; }
    const std::string& description() const { return _description; }
    const char* what() const noexcept override { return _description.c_str(); }

private:
    int _code;
    std::string _description;
};

inline constexpr int CIM_ERR_FAILED = 1;
inline constexpr int CIM_ERR_INVALID_NAMESPACE = 3;
inline constexpr int CIM_ERR_INVALID_PARAMETER = 4;
inline constexpr int CIM_ERR_INVALID_CLASS = 5;
inline constexpr int CIM_ERR_NOT_FOUND = 6;
inline constexpr int CIM_ERR_NOT_SUPPORTED = 7;
inline constexpr int CIM_ERR_ALREADY_EXISTS = 11;
inline constexpr int CIM_ERR_NO_SUCH_PROPERTY = 12;
inline constexpr int CIM_ERR_TYPE_MISMATCH = 13;
inline constexpr int CIM_ERR_QUERY_LANGUAGE_NOT_SUPPORTED = 14;
inline constexpr int CIM_ERR_INVALID_QUERY = 15;
inline constexpr int CIM_ERR_METHOD_NOT_AVAILABLE = 16;
inline constexpr int CIM_ERR_METHOD_NOT_FOUND = 17;
inline constexpr int CIM_ERR_SERVER_LIMITS_EXCEEDED = 27;

} // namespace cimserver
