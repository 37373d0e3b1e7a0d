// Texts of a request as values of a CIM type.
#pragma once

#include "cimserver/model/values.h"

#include <optional>
#include <string_view>

namespace cimserver
{

// The content of a scalar as a value of the type, or null when it is none: what is typed already stays, a text is read as
// DSP0201 writes the type. Numbers are decimal, or hexadecimal after "0x"; booleans "TRUE" and "FALSE" in any case; a char16 is
// one UTF-8 character; blanks around all these do not count. Not for references and embedded instances.
Value::Content scalar_content(const Value& value, CMPIType type);

// TRUE or FALSE in any case, and any number, with or without blanks around it.
std::optional<bool> read_boolean_text(std::string_view text);
bool is_number_text(std::string_view text);

// A text without the blanks around it: around a number, a boolean or a datetime they are a client's layout.
std::string_view trimmed(std::string_view text);

} // namespace cimserver
