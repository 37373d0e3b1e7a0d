// The CIM scalar types and their CMPI codes, and a way to pick code by a type that is known at run time only.
#pragma once

#include "runtime/value.h"

#include <cmpidt.h>

#include <type_traits>

namespace zmlr
{

struct CMPI_Type_Row
{
    Value::Type type;
    CMPIType cmpi_type;
};

// Indexed by Value::Type. A reference has no row of its own kind: it is CMPI_ref or CMPI_instance.
// clang-format off
inline constexpr CMPI_Type_Row cmpi_types[num_types] = {
    {Value::BOOLEAN,  CMPI_boolean},
    {Value::UINT8,    CMPI_uint8},
    {Value::SINT8,    CMPI_sint8},
    {Value::UINT16,   CMPI_uint16},
    {Value::SINT16,   CMPI_sint16},
    {Value::UINT32,   CMPI_uint32},
    {Value::SINT32,   CMPI_sint32},
    {Value::UINT64,   CMPI_uint64},
    {Value::SINT64,   CMPI_sint64},
    {Value::REAL32,   CMPI_real32},
    {Value::REAL64,   CMPI_real64},
    {Value::CHAR16,   CMPI_char16},
    {Value::STRING,   CMPI_string},
    {Value::DATETIME, CMPI_dateTime},
};
// clang-format on

inline bool is_array(Value::Type type) { return type >= Value::BOOLEAN_ARRAY; }
inline Value::Type element_of(Value::Type array) { return static_cast<Value::Type>(array - Value::BOOLEAN_ARRAY); }

// Answers f(std::type_identity<T>()) for the type T of a CIM scalar, 0 to 13; -1 for anything else.
template <class F> int with_type(Value::Type scalar, F f)
{
    switch (scalar)
    {
    case Value::BOOLEAN:
        return f(std::type_identity<boolean>());
    case Value::UINT8:
        return f(std::type_identity<uint8>());
    case Value::SINT8:
        return f(std::type_identity<sint8>());
    case Value::UINT16:
        return f(std::type_identity<uint16>());
    case Value::SINT16:
        return f(std::type_identity<sint16>());
    case Value::UINT32:
        return f(std::type_identity<uint32>());
    case Value::SINT32:
        return f(std::type_identity<sint32>());
    case Value::UINT64:
        return f(std::type_identity<uint64>());
    case Value::SINT64:
        return f(std::type_identity<sint64>());
    case Value::REAL32:
        return f(std::type_identity<real32>());
    case Value::REAL64:
        return f(std::type_identity<real64>());
    case Value::CHAR16:
        return f(std::type_identity<char16>());
    case Value::STRING:
        return f(std::type_identity<String>());
    case Value::DATETIME:
        return f(std::type_identity<Datetime>());
    default:
        return -1;
    }
}

} // namespace zmlr
