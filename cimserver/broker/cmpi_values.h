// Between CMPI data and the server's model.
#pragma once

#include "cimserver/broker/objects.h"
#include "cimserver/model/cim_types.h"
#include "cimserver/model/values.h"

#include <string>

namespace cimserver
{

// Whether a CIM value (or an array's element) can have the type: no array bit, none of the types that only calls use.
bool is_scalar(CMPIType type);

// The value behind a CMPI argument. CMPI_chars becomes a string: the argument itself is the text. A null argument, and a
// null object in it, is a null value of the type. Throws INVALID_DATA_TYPE for a type that no CIM value has.
Value from_cmpi(const CMPIValue* value, CMPIType type);

// The data that says the same; strings, arrays, paths and so on are new objects of the thread's arena.
CMPIData to_cmpi(const Value& value);

// The value of an element of a named list, as getKey, getArg and getEntry answer it: NOT_FOUND when there is none.
CMPIData data_named(const std::vector<Named_Value>& list, const char* name);
CMPIData data_at(const std::vector<Named_Value>& list, CMPICount index, CMPIString** name);

} // namespace cimserver
