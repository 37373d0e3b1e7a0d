// Puts the answer of an operation into its CIM-XML response message (DSP0201).
#pragma once

#include "cimserver/cimxml/request_reader.h"
#include "cimserver/cimxml/xml_writer.h"
#include "cimserver/model/operations.h"
#include "cimserver/model/values.h"

#include <functional>
#include <string>

namespace cimserver
{

// A response to an intrinsic operation with the children of its IRETURNVALUE, which `content` writes. What it throws passes
// through.
std::string write_success(const Cimxml_Request& request, const std::function<void(Xml_Writer&)>& content);

// A response to an intrinsic operation that returns nothing, once `run` has run. What it throws passes through.
std::string write_empty_success(const Cimxml_Request& request, const std::function<void(Xml_Writer&)>& run);

// A response to a method call: the return value, unless it is null, and the output parameters that have a value.
std::string write_method_result(const Cimxml_Request& request, const Method_Result& result);

// An ERROR response to either kind of request. A long description is cut: it may quote what the client sent.
std::string write_error(const Cimxml_Request& request, const Cim_Error& error);

} // namespace cimserver
