#include "cimserver/cimxml/parameters.h"

#include "cimserver/cimxml/object_reader.h"
#include "cimserver/model/names.h"

namespace cimserver
{
namespace
{

[[noreturn]] void fail(std::string_view what, std::string_view name)
{
    throw Cim_Error(CIM_ERR_INVALID_PARAMETER, std::string(what) + ": " + std::string(name));
}

bool is_parameter(const Xml_Element& element) { return element.name == "IPARAMVALUE"; }

const std::string& name_of(const Xml_Element& parameter) { return *parameter.attribute("NAME"); }

} // namespace

Parameters::Parameters(const Cimxml_Request& request, std::span<const std::string_view> known) : _request(request)
{
    for (const Xml_Element& parameter : request.call.children)
    {
        if (!is_parameter(parameter))
            continue;
        const std::string& name = name_of(parameter);
        if (!is_among(known, name))
            fail("unknown parameter", name);
        if (find(name) != &parameter)
            fail("parameter given twice", name);
    }
}

std::string Parameters::class_name(std::string_view name) const
{
    std::string class_name = optional_class_name(name);
    if (class_name.empty())
        fail("missing parameter", name);
    return class_name;
}

std::string Parameters::optional_class_name(std::string_view name) const
{
    const Xml_Element* value = value_of(name, "CLASSNAME");
    return value ? *value->attribute("NAME") : std::string();
}

Object_Path Parameters::instance_name(std::string_view name) const
{
    return read_path(required(name, "INSTANCENAME"), name_space());
}

Object_Path Parameters::object_name(std::string_view name) const
{
    const Xml_Element* parameter = find(name);
    if (parameter && !parameter->children.empty() && parameter->children.front().name == "CLASSNAME")
        throw Cim_Error(CIM_ERR_NOT_SUPPORTED, "associations of classes are not told, only of instances");
    return instance_name(name);
}

Instance Parameters::instance(std::string_view name) const { return read_instance(required(name, "INSTANCE"), name_space()); }

Instance Parameters::named_instance(std::string_view name) const
{
    return read_instance(required(name, "VALUE.NAMEDINSTANCE"), name_space());
}

std::string Parameters::text(std::string_view name) const { return required(name, "VALUE").text; }

std::string Parameters::optional_text(std::string_view name) const
{
    const Xml_Element* value = value_of(name, "VALUE");
    return value ? value->text : std::string();
}

Value Parameters::value(std::string_view name) const
{
    const Xml_Element* parameter = find(name);
    return parameter && !parameter->children.empty() ? read_value(parameter->children.front(), name_space()) : Value();
}

bool Parameters::boolean(std::string_view name, bool default_value) const
{
    const Xml_Element* value = value_of(name, "VALUE");
    return value ? read_boolean(value->text) : default_value;
}

Property_List Parameters::property_list(std::string_view name) const
{
    const Xml_Element* value = value_of(name, "VALUE.ARRAY");
    if (!value)
        return std::nullopt;
    std::vector<std::string> names;
    for (const Xml_Element& element : value->children)
    {
        if (element.name != "VALUE")
            fail("null in a list of names", name);
        names.push_back(element.text);
    }
    return names;
}

const Xml_Element* Parameters::find(std::string_view name) const
{
    for (const Xml_Element& parameter : _request.call.children)
        if (is_parameter(parameter) && equal_names(name_of(parameter), name))
            return &parameter;
    return nullptr;
}

const Xml_Element& Parameters::required(std::string_view name, std::string_view element) const
{
    const Xml_Element* value = value_of(name, element);
    if (!value)
        fail("missing parameter", name);
    return *value;
}

const Xml_Element* Parameters::value_of(std::string_view name, std::string_view element) const
{
    const Xml_Element* parameter = find(name);
    if (!parameter || parameter->children.empty())
        return nullptr;
    if (parameter->children.front().name != element)
        fail("parameter of another type than " + std::string(element), name);
    return &parameter->children.front();
}

std::vector<Named_Value> read_arguments(const Cimxml_Request& method_call, const std::string& name_space)
{
    std::vector<Named_Value> arguments;
    for (const Xml_Element& parameter : method_call.call.children)
        if (parameter.name == "PARAMVALUE")
            arguments.push_back(
                {name_of(parameter), parameter.children.empty() ? Value() : read_value(parameter.children.front(), name_space)});
    return arguments;
}

} // namespace cimserver
