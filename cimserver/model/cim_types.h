// The CIM types that a value can have.
#pragma once

#include <cmpidt.h>

namespace cimserver
{

struct Cim_Type
{
    CMPIType code;
    const char* name;
    unsigned bits; // of an integer and a char16, else 0
    bool is_signed;
};

constexpr CMPIType array_of(CMPIType type) { return static_cast<CMPIType>(type | CMPI_ARRAY); }
constexpr CMPIType element_of(CMPIType type) { return static_cast<CMPIType>(type & ~CMPI_ARRAY); }

// A scalar type, or that of an array's elements; null for a code that no value can have.
const Cim_Type* find_type(CMPIType type);

// Its name: "boolean" ... "datetime", "reference"; "string" for an embedded instance. Null as above.
const char* cim_type_name(CMPIType type);

// The CMPI code of a type of the meta-data (zmlr::Type); CMPI_null for an unknown one.
CMPIType cmpi_type(unsigned type);

} // namespace cimserver
