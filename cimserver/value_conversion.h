// Texts of a request as values of a CIM type.
#pragma once

#include "cimserver/broker/model.h"

namespace cimserver
{

// The content of a scalar as a value of the type, or null when it is none: what is typed already stays, a text is read as
// DSP0201 writes the type. Numbers are decimal, or hexadecimal after "0x"; booleans "TRUE" and "FALSE" in any case; a char16 is
// one UTF-8 character; blanks around all these do not count. Not for references and embedded instances.
Value::Content scalar_content(const Value& value, CMPIType type);

} // namespace cimserver
