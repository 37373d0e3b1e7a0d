// Between CMPI data and the server's model.
#pragma once

#include "cimserver/broker/model.h"
#include "cimserver/broker/objects.h"

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

// Adds a value to such a list, in the place of one of the same name.
void put(std::vector<Named_Value>& list, const char* name, Value value);

// The path as one line: "root/zemlar:Class.Key=value,...", texts and referenced paths between double quotes. Each level of
// references doubles the escapes below it: not for paths whose depth nobody has checked.
std::string path_text(const Object_Path& path);

} // namespace cimserver
