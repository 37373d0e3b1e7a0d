// The parameters of an intrinsic operation, read by name and type (DSP0200), and the arguments of a method. Names are compared
// without regard to case.
#pragma once

#include "cimserver/cimxml/request_reader.h"
#include "cimserver/model/values.h"

#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace cimserver
{

// Every function throws Cim_Error (invalid parameter) when the parameter is there but not of the type asked for. A parameter
// without a value counts as left out. The request must outlive the object.
class Parameters
{
public:
    // Throws Cim_Error (invalid parameter) when the request holds a name twice or one that is not in `known`.
    Parameters(const Cimxml_Request& request, std::span<const std::string_view> known);

    const std::string& name_space() const { return _request.name_space; }

    std::string class_name(std::string_view name) const;          // throws when left out
    std::string optional_class_name(std::string_view name) const; // "" when left out
    Object_Path instance_name(std::string_view name) const;       // throws when left out
    Object_Path object_name(std::string_view name) const;         // of an instance; a class is CIM_ERR_NOT_SUPPORTED
    Instance instance(std::string_view name) const;               // an INSTANCE; throws when left out
    Instance named_instance(std::string_view name) const;         // a VALUE.NAMEDINSTANCE; throws when left out
    std::string text(std::string_view name) const;                // throws when left out
    std::string optional_text(std::string_view name) const;       // "" when left out
    Value value(std::string_view name) const;                     // null when left out
    bool boolean(std::string_view name, bool default_value) const;
    Property_List property_list(std::string_view name) const;

private:
    const Xml_Element* find(std::string_view name) const; // the IPARAMVALUE
    const Xml_Element* value_of(std::string_view name, std::string_view element) const;
    const Xml_Element& required(std::string_view name, std::string_view element) const;

    const Cimxml_Request& _request;
};

// The arguments of a METHODCALL, untyped; references that name no name space take the one given. What an argument says of its
// type is passed over: the method knows it.
std::vector<Named_Value> read_arguments(const Cimxml_Request& method_call, const std::string& name_space);

} // namespace cimserver
