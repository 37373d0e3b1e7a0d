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

enum class Answer
{
    value,  // an IRETURNVALUE, perhaps empty
    nothing // no IRETURNVALUE at all
};

// A response to an intrinsic operation, once `run` has run, which writes the children of the IRETURNVALUE. What it throws passes
// through.
std::string write_success(const Cimxml_Request& request, Answer answer, const std::function<void(Xml_Writer&)>& run);

// A response to a method call: the return value, unless it is null, and the output parameters that have a value.
std::string write_method_result(const Cimxml_Request& request, const Method_Result& result);

// An ERROR response to either kind of request. A long description is cut: it may quote what the client sent.
std::string write_error(const Cimxml_Request& request, const Cim_Error& error);

} // namespace cimserver
