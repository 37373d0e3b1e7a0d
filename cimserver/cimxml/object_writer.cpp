#include "cimserver/cimxml/object_writer.h"

#include "cimserver/model/meta_search.h"
#include "cimserver/model/server_identity.h"
#include "cimserver/model/value_text.h"

#include <algorithm>
#include <optional>

namespace cimserver
{
namespace
{

void write_local_name_space(Xml_Writer& writer, const std::string& name_space)
{
    writer.start("LOCALNAMESPACEPATH");
    for (std::size_t first = 0; first <= name_space.size();)
    {
        const std::size_t slash = std::min(name_space.find('/', first), name_space.size());
        writer.start("NAMESPACE").attribute("NAME", name_space.substr(first, slash - first)).end();
        first = slash + 1;
    }
    writer.end();
}

const char* value_type_of(CMPIType type)
{
    if (type == CMPI_boolean)
        return "boolean";
    return (type & (CMPI_REAL | CMPI_INTEGER)) != 0 && (type & CMPI_ENC) == 0 ? "numeric" : "string";
}

void write_key_value(Xml_Writer& writer, const Value& value)
{
    const std::optional<std::string> text = value_text(value);
    writer.start("KEYVALUE").attribute("VALUETYPE", text ? value_type_of(value.type) : "string");
    // A key that clients could refuse as a datetime still names its instance as a text.
    if (text)
        writer.attribute("TYPE", cim_type_name(value.type)).text(*text);
    else if (const auto* raw = value.as<Text>())
        writer.text(*raw);
    writer.end();
}

void write_key(Xml_Writer& writer, const Named_Value& key)
{
    if (key.value.null())
        return;
    writer.start("KEYBINDING").attribute("NAME", key.name);
    if (const auto* reference = key.value.as<Object_Path>())
        write_reference(writer, *reference);
    else
        write_key_value(writer, key.value);
    writer.end();
}

// The texts of an array's elements; nothing when one of them cannot be sent. A null text is sent as an empty one: clients
// know no null inside an array.
std::optional<std::vector<std::string>> element_texts(const std::vector<Value>& elements, bool texts)
{
    std::vector<std::string> result;
    result.reserve(elements.size());
    for (const Value& element : elements)
    {
        std::optional<std::string> text = value_text(element);
        if (!text && !(texts && element.null()))
            return std::nullopt;
        result.push_back(text ? std::move(*text) : std::string());
    }
    return result;
}

void write_array(Xml_Writer& writer, const std::vector<Value>& elements, CMPIType type)
{
    const auto texts = element_texts(elements, element_of(type) == CMPI_string);
    if (!texts)
        return;
    writer.start("VALUE.ARRAY");
    for (const std::string& text : *texts)
        writer.element("VALUE", text);
    writer.end();
}

void write_property(Xml_Writer& writer, const Properties::Property& property, const zmlr::Meta_Class* origins)
{
    const CMPIType type = property.value.type;
    if (!cim_type_name(type) || type == (CMPI_ref | CMPI_ARRAY))
        return;
    writer.start(type == CMPI_ref ? "PROPERTY.REFERENCE" : (type & CMPI_ARRAY) != 0 ? "PROPERTY.ARRAY" : "PROPERTY");
    writer.attribute("NAME", property.name);
    if (type != CMPI_ref)
        writer.attribute("TYPE", cim_type_name(type));
    if (const zmlr::Meta_Class* origin = origins ? origin_of(*origins, property.name) : nullptr)
        writer.attribute("CLASSORIGIN", origin->name);
    write_any_value(writer, property.value);
    writer.end();
}

// Nothing when an element is null: clients know no null inside an array.
void write_reference_array(Xml_Writer& writer, const Value& value)
{
    const auto* elements = value.as<std::vector<Value>>();
    if (!elements || !std::ranges::all_of(*elements, &Value::as<Object_Path>))
        return;
    writer.start("VALUE.REFARRAY");
    for (const Value& element : *elements)
        write_reference(writer, element.get<Object_Path>());
    writer.end();
}

} // namespace

void write_instance_name(Xml_Writer& writer, const Object_Path& path)
{
    writer.start("INSTANCENAME").attribute("CLASSNAME", path.class_name);
    for (const Named_Value& key : path.keys)
        write_key(writer, key);
    writer.end();
}

void write_reference(Xml_Writer& writer, const Object_Path& path)
{
    writer.start("VALUE.REFERENCE");
    if (path.name_space.empty())
        write_instance_name(writer, path);
    else if (path.host.empty())
    {
        writer.start("LOCALINSTANCEPATH");
        write_local_name_space(writer, path.name_space);
        write_instance_name(writer, path);
        writer.end();
    }
    else
        write_instance_path(writer, path);
    writer.end();
}

void write_instance_path(Xml_Writer& writer, const Object_Path& path)
{
    writer.start("INSTANCEPATH").start("NAMESPACEPATH").element("HOST", path.host.empty() ? host_name() : path.host.string());
    write_local_name_space(writer, path.name_space);
    writer.end();
    write_instance_name(writer, path);
    writer.end();
}

void write_object_with_path(Xml_Writer& writer, const Instance& instance, const zmlr::Meta_Class* origins)
{
    writer.start("VALUE.OBJECTWITHPATH");
    write_instance_path(writer, instance.path);
    write_instance(writer, instance, origins);
    writer.end();
}

void write_instance(Xml_Writer& writer, const Instance& instance, const zmlr::Meta_Class* origins)
{
    writer.start("INSTANCE").attribute("CLASSNAME", instance.path.class_name);
    for (const auto& property : instance.properties)
        write_property(writer, property, origins);
    writer.end();
}

void write_value(Xml_Writer& writer, const Value& value)
{
    if (const auto* elements = value.as<std::vector<Value>>())
        write_array(writer, *elements, value.type);
    else if (const std::optional<std::string> text = value_text(value))
        writer.element("VALUE", *text);
}

void write_any_value(Xml_Writer& writer, const Value& value)
{
    if (const auto* path = value.as<Object_Path>())
        write_reference(writer, *path);
    else if (value.type == (CMPI_ref | CMPI_ARRAY))
        write_reference_array(writer, value);
    else
        write_value(writer, value);
}

bool can_be_sent(const Value& value)
{
    if (!cim_type_name(value.type))
        return false;
    Xml_Writer writer;
    write_any_value(writer, value);
    return !writer.take().empty();
}

void write_output_parameter(Xml_Writer& writer, const Named_Value& parameter)
{
    if (!can_be_sent(parameter.value))
        return;
    writer.start("PARAMVALUE").attribute("NAME", parameter.name).attribute("PARAMTYPE", cim_type_name(parameter.value.type));
    write_any_value(writer, parameter.value);
    writer.end();
}

} // namespace cimserver
