// The text of a CIM value in CIM-XML (DSP0201).
#pragma once

#include "cimserver/model/cim_types.h"
#include "cimserver/model/values.h"

#include <optional>
#include <string>
#include <string_view>

namespace cimserver
{

// The text of a scalar other than a reference or an embedded instance. Nothing for a null value and for one that a client
// could refuse, and its whole answer with it: an integer beyond its type, a char16 that is no character, a datetime that is
// none. It is then sent as a null.
std::optional<std::string> value_text(const Value& value);

// Whether a text is a datetime that clients read: 25 characters, a calendar day of the years 1 to 9999 with a time of day and
// an offset below one day, or an interval of days and a time of day.
bool is_readable_datetime(std::string_view text);

} // namespace cimserver
