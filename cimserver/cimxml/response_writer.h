// Puts the answer of an operation into its CIM-XML response message (DSP0201).
#pragma once

#include "cimserver/broker/model.h"
#include "cimserver/cimxml/request_reader.h"
#include "cimserver/cimxml/xml_writer.h"

#include <functional>
#include <string>

namespace cimserver
{

// A response to an intrinsic operation with the children of its IRETURNVALUE, which `content` writes. What it throws passes
// through.
std::string write_success(const Cimxml_Request& request, const std::function<void(Xml_Writer&)>& content);

// An ERROR response to either kind of request.
std::string write_error(const Cimxml_Request& request, const Cim_Error& error);

} // namespace cimserver
