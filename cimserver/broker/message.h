// The texts of getMessage: a template with the places $0 to $9 and the values that go there.
#pragma once

#include <cmpidt.h>

#include <cstdarg>
#include <string>

namespace cimserver
{

// The template with its places filled. `arguments` holds `count` pairs of a CMPIType and a value of that type, as the
// standard's message macros pass them; ten at most are read. A place without a value stays as it is. Throws
// INVALID_DATA_TYPE when a type is none that a message can hold.
std::string format_message(const std::string& text, CMPICount count, std::va_list* arguments);

} // namespace cimserver
