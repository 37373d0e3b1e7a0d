// Reads one CIM-XML request message (DSP0200, DSP0201): an intrinsic operation or an extrinsic method call.
#pragma once

#include "cimserver/cimxml/xml_tree.h"

#include <string>
#include <string_view>

namespace cimserver
{

struct Cimxml_Request
{
    std::string message_id; // returned to the client as it is
    bool intrinsic = true;  // IMETHODCALL, else METHODCALL
    std::string method;     // the operation's or method's name as the client wrote it
    std::string name_space; // of an intrinsic operation; a method's target has its own
    Xml_Element call;       // the IMETHODCALL or METHODCALL: the parameters are read from it
};

// Throws Http_Refusal: 400 for what is not well-formed or no CIM-XML request, 501 for a batch of requests and for a version
// of CIM, of the DTD (major 2) or of the protocol (major 1) that is not spoken here.
Cimxml_Request read_request(std::string_view body);

// The object that a METHODCALL names: its LOCALCLASSPATH or LOCALINSTANCEPATH.
const Xml_Element& target_of(const Cimxml_Request& method_call);

} // namespace cimserver
