// The text of a CIM value in CIM-XML (DSP0201), and the names of the CIM types.
#pragma once

#include "cimserver/broker/model.h"

#include <optional>
#include <string>
#include <string_view>

namespace cimserver
{

// The name of a scalar type or of an array's element type: "boolean" ... "datetime", "reference"; "string" for an embedded
// instance. Null for a code that no value can have.
const char* cim_type_name(CMPIType type);

// The CMPI code of a type of the meta-data (zmlr::Type); CMPI_null for an unknown one.
CMPIType cmpi_type(unsigned type);

// The text of a scalar other than a reference or an embedded instance. Nothing for a null value and for one that a client
// could refuse, and its whole answer with it: an integer beyond its type, a char16 that is no character, a datetime that is
// none. It is then sent as a null.
std::optional<std::string> value_text(const Value& value);

// A text without the blanks around it: around a number, a boolean or a datetime they are a client's layout.
std::string_view trimmed(std::string_view text);

// Whether a text is a datetime that clients read: 25 characters, a calendar day of the years 1 to 9999 with a time of day and
// an offset below one day, or an interval of days and a time of day.
bool is_readable_datetime(const std::string& text);

} // namespace cimserver
