#include "cimserver/cimxml/object_reader.h"

#include "cimserver/cimxml/http_message.h"
#include "cimserver/cimxml/request_rules.h"
#include "cimserver/model/cim_types.h"
#include "cimserver/model/names.h"
#include "cimserver/model/value_reader.h"

namespace cimserver
{
namespace
{

[[noreturn]] void fail(const std::string& description) { throw Cim_Error(CIM_ERR_INVALID_PARAMETER, description); }

Value text_value(std::string text) { return Value{CMPI_string, std::move(text)}; }

Value read_key_value(const Xml_Element& element)
{
    const std::string* value_type = element.attribute("VALUETYPE");
    if (!value_type || *value_type == "string")
        return text_value(element.text);
    if (*value_type == "boolean")
        return Value{CMPI_boolean, read_boolean(element.text)};
    if (*value_type != "numeric")
        fail("unknown VALUETYPE of a key: " + *value_type);
    if (!is_number_text(element.text))
        fail("not a number: " + element.text);
    return text_value(std::string(trimmed(element.text)));
}

Value read_key(const Xml_Element& element, const std::string& name_space)
{
    if (element.name == "KEYVALUE")
        return read_key_value(element);
    return Value{CMPI_ref, read_path(element, name_space)};
}

void add_key(Object_Path& path, const Xml_Element& binding)
{
    if (binding.name != "KEYBINDING")
        fail("more than one unnamed key");
    const std::string& name = *binding.attribute("NAME");
    if (name.empty() || find_named(path.keys, name))
        fail("key without a name of its own: " + name);
    path.keys.push_back({name, read_key(binding.children.front(), path.name_space)});
}

Object_Path read_instance_name(const Xml_Element& element, const std::string& name_space)
{
    Object_Path path{{}, name_space, *element.attribute("CLASSNAME"), {}};
    if (element.children.size() == 1 && element.children.front().name != "KEYBINDING")
    {
        path.keys.push_back({"", read_key(element.children.front(), name_space)});
        return path;
    }
    for (const Xml_Element& binding : element.children)
        add_key(path, binding);
    return path;
}

// CLASSPATH, INSTANCEPATH and their local forms: where, then what.
Object_Path read_full_path(const Xml_Element& element)
{
    const Xml_Element& where = element.children.front();
    const Xml_Element& what = element.children.back();
    const bool with_host = where.name == "NAMESPACEPATH";
    const Xml_Element& local = with_host ? where.children.back() : where;
    if (local.name != "LOCALNAMESPACEPATH" || what.name == where.name || (with_host && where.children.front().name != "HOST"))
        fail("malformed " + element.name);
    Object_Path path = read_path(what, read_name_space(local));
    if (with_host)
        path.host = where.children.front().text;
    return path;
}

Value read_array(const Xml_Element& element, CMPIType element_type, const std::string& name_space)
{
    std::vector<Value> elements;
    for (const Xml_Element& child : element.children)
        elements.push_back(child.name == "VALUE.NULL" ? Value{element_type, {}} : read_value(child, name_space));
    return {array_of(element_type), std::move(elements)};
}

Named_Value read_property(const Xml_Element& element, const std::string& name_space)
{
    Named_Value property{*element.attribute("NAME"), {}};
    for (const Xml_Element& child : element.children)
    {
        if (child.name == "QUALIFIER")
            continue;
        if (property.value.type != CMPI_null)
            fail("property with two values: " + property.name.string());
        property.value = read_value(child, name_space);
    }
    return property;
}

} // namespace

Value read_value(const Xml_Element& element, const std::string& name_space)
{
    if (element.name == "VALUE")
        return text_value(element.text);
    if (element.name == "VALUE.ARRAY")
        return read_array(element, CMPI_string, name_space);
    if (element.name == "VALUE.REFARRAY")
        return read_array(element, CMPI_ref, name_space);
    if (element.name == "INSTANCE" || element.name == "VALUE.NAMEDINSTANCE")
        return {CMPI_instance, read_instance(element, name_space)};
    if (element.name == "CLASS")
        fail("a class is no value here");
    return {CMPI_ref, read_path(element, name_space)};
}

Instance read_instance(const Xml_Element& element, const std::string& name_space)
{
    const bool named = element.name == "VALUE.NAMEDINSTANCE";
    const Xml_Element& body = named ? element.children.back() : element;
    if (body.name != "INSTANCE" || (named && element.children.front().name != "INSTANCENAME"))
        fail("malformed " + element.name);

    Object_Path path{{}, name_space, *body.attribute("CLASSNAME"), {}};
    if (named)
        path = read_path(element.children.front(), name_space);
    std::vector<Named_Value> properties;
    for (const Xml_Element& child : body.children)
        if (child.name != "QUALIFIER")
            properties.push_back(read_property(child, name_space));
    return {std::move(path), std::move(properties)};
}

std::string read_name_space(const Xml_Element& element)
{
    std::string name_space;
    for (const Xml_Element& part : element.children)
        name_space += (name_space.empty() ? "" : "/") + *part.attribute("NAME");
    return name_space;
}

Object_Path read_path(const Xml_Element& element, const std::string& name_space)
{
    if (element.name == "CLASSNAME")
        return {{}, name_space, *element.attribute("NAME"), {}};
    if (element.name == "INSTANCENAME")
        return read_instance_name(element, name_space);
    if (element.name == "VALUE.REFERENCE")
        return read_path(element.children.front(), name_space);
    return read_full_path(element);
}

bool read_boolean(std::string_view text)
{
    const auto flag = read_boolean_text(text);
    if (!flag)
        fail("neither true nor false: " + std::string(text));
    return *flag;
}

} // namespace cimserver
