// The shape of a CIM-XML request (DSP0201, DSP0203): which elements may stand where, and which attributes they need.
#pragma once

#include "cimserver/cimxml/xml_tree.h"

namespace cimserver
{

// Throws Http_Refusal 400 "request-not-valid" when the element or anything below it has not the shape of its rule. Unknown
// attributes are tolerated, and so is whitespace between elements.
void check_rules(const Xml_Element& element);

} // namespace cimserver
