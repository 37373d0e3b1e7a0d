// The CIM-XML message that carries an indication to a listener (DSP0200, DSP0201).
#pragma once

#include "cimserver/model/values.h"

#include <string>

namespace cimserver
{

// A whole message with an ID that no other of this process has.
std::string export_message(const Instance& indication);

// Whether a listener's answer tells that it does not take the indication. What is no CIM-XML tells nothing.
bool tells_error(const std::string& answer);

} // namespace cimserver
