// Reads names, paths, values and instances of CIM-XML (DSP0201) whose shape has been checked by check_rules().
#pragma once

#include "cimserver/cimxml/xml_tree.h"
#include "cimserver/model/values.h"

#include <string>
#include <string_view>

namespace cimserver
{

// A LOCALNAMESPACEPATH as "a/b".
std::string read_name_space(const Xml_Element& element);

// A CLASSNAME, INSTANCENAME, one of the four paths around them, or a VALUE.REFERENCE. What the element leaves out of its
// name space is the one given. Key values arrive untyped: a boolean as CMPI_boolean, a string and a number as the text
// (CMPI_string), a reference as CMPI_ref; the single unnamed key has an empty name. Throws Cim_Error (invalid parameter)
// for a boolean or a number that is none, for keys named twice and for a mixture of named and unnamed keys.
Object_Path read_path(const Xml_Element& element, const std::string& name_space);

// The value that one of the elements VALUE, VALUE.ARRAY, VALUE.REFERENCE, VALUE.REFARRAY, CLASSNAME, INSTANCENAME, INSTANCE and
// VALUE.NAMEDINSTANCE writes, untyped: texts, references, instances and arrays of texts or references. An element that is null
// in an array is a null value. Throws Cim_Error (invalid parameter) for a CLASS, and for what read_path refuses.
Value read_value(const Xml_Element& element, const std::string& name_space);

// An INSTANCE or a VALUE.NAMEDINSTANCE, which has the path in front; qualifiers are passed over, and what a property says of
// its type too: the class knows it. Throws Cim_Error (invalid parameter) for a property with two values.
Instance read_instance(const Xml_Element& element, const std::string& name_space);

// TRUE or FALSE in any case, surrounded by blanks or not; anything else throws Cim_Error (invalid parameter).
bool read_boolean(std::string_view text);

} // namespace cimserver
