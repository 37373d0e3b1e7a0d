#include "cimserver/cimxml/class_writer.h"

#include "cimserver/cimxml/default_value.h"
#include "cimserver/cimxml/object_writer.h"
#include "cimserver/cimxml/qualifier_writer.h"
#include "cimserver/model/meta_search.h"
#include "cimserver/model/names.h"
#include "cimserver/model/value_text.h"

#include <string>

namespace cimserver
{
namespace
{

constexpr zmlr::uint32 embedding = zmlr::Flag_EmbeddedInstance | zmlr::Flag_EmbeddedObject;

// Features and parameters of one shape differ in their element's name only.
struct Element_Names
{
    const char* scalar;
    const char* array;
    const char* reference;
    const char* reference_array; // null: cannot be written
};

constexpr Element_Names property_elements{"PROPERTY", "PROPERTY.ARRAY", "PROPERTY.REFERENCE", nullptr};
constexpr Element_Names parameter_elements{"PARAMETER", "PARAMETER.ARRAY", "PARAMETER.REFERENCE", "PARAMETER.REFARRAY"};

bool is_embedded(const zmlr::Meta_Feature& feature) { return (feature.flags & embedding) != 0; }

int subscript_of(const zmlr::Meta_Feature& feature)
{
    if (zmlr::is_property(&feature))
        return zmlr::as_property(&feature)->subscript;
    return zmlr::as_reference(&feature)->subscript != 0 ? -1 : 0;
}

const char* element_name(const zmlr::Meta_Feature& feature, const Element_Names& names)
{
    const bool array = subscript_of(feature) != 0;
    if (zmlr::is_reference(&feature))
        return array ? names.reference_array : names.reference;
    return array ? names.array : names.scalar;
}

const char* type_of(const zmlr::Meta_Feature& feature)
{
    const char* name = zmlr::is_property(&feature) ? cim_type_name(cmpi_type(zmlr::as_property(&feature)->type)) : nullptr;
    return name ? name : "string"; // embedded objects travel as texts
}

void start_typed(Xml_Writer& writer, const char* element, const zmlr::Meta_Feature& feature)
{
    writer.start(element).attribute("NAME", feature.name);
    if (zmlr::is_reference(&feature))
        writer.attribute("REFERENCECLASS", zmlr::as_reference(&feature)->meta_class->name);
    else
        writer.attribute("TYPE", type_of(feature));
    if (const int subscript = subscript_of(feature); subscript > 0)
        writer.attribute("ARRAYSIZE", std::to_string(subscript));
}

void write_origin(Xml_Writer& writer, const zmlr::Meta_Class& meta_class, unsigned index, const Class_Selection& selection)
{
    const zmlr::Meta_Class* origin =
        selection.class_origin ? origin_of(meta_class, meta_class.meta_features[index]->name) : nullptr;
    if (origin)
        writer.attribute("CLASSORIGIN", origin->name);
    if (!is_local(meta_class, index))
        writer.attribute("PROPAGATED", "true");
}

void write_property(Xml_Writer& writer, const zmlr::Meta_Class& meta_class, unsigned index, const Class_Selection& selection)
{
    const zmlr::Meta_Feature& feature = *meta_class.meta_features[index];
    const char* element = element_name(feature, property_elements);
    if (!element)
        return;
    start_typed(writer, element, feature);
    write_origin(writer, meta_class, index, selection);
    if (is_embedded(feature) && subscript_of(feature) == 0)
        writer.attribute("EmbeddedObject", (feature.flags & zmlr::Flag_EmbeddedInstance) != 0 ? "instance" : "object");
    if (selection.qualifiers)
        write_feature_qualifiers(writer, meta_class, index);
    if (zmlr::is_property(&feature) && !is_embedded(feature))
        write_value(writer, default_of(*zmlr::as_property(&feature)));
    writer.end();
}

void write_method(Xml_Writer& writer, const zmlr::Meta_Class& meta_class, unsigned index, const Class_Selection& selection)
{
    const zmlr::Meta_Method& method = *zmlr::as_method(meta_class.meta_features[index]);
    const char* type = cim_type_name(cmpi_type(method.return_type));
    writer.start("METHOD").attribute("NAME", method.name).attribute("TYPE", type ? type : "uint32");
    write_origin(writer, meta_class, index, selection);
    if (selection.qualifiers)
        write_feature_qualifiers(writer, meta_class, index);
    for (unsigned i = 0; i < method.num_meta_features; ++i)
    {
        const zmlr::Meta_Feature& parameter = *method.meta_features[i];
        if (equal_names(parameter.name, "return_value"))
            continue;
        start_typed(writer, element_name(parameter, parameter_elements), parameter);
        if (selection.qualifiers)
            write_parameter_qualifiers(writer, meta_class, method, parameter);
        writer.end();
    }
    writer.end();
}

bool is_selected(const zmlr::Meta_Class& meta_class, unsigned index, const Class_Selection& selection)
{
    const zmlr::Meta_Feature& feature = *meta_class.meta_features[index];
    if (selection.local_only && !is_local(meta_class, index))
        return false;
    return zmlr::is_method(&feature) || !selection.properties || is_among(*selection.properties, feature.name);
}

using Writer_Of_Feature = void (*)(Xml_Writer&, const zmlr::Meta_Class&, unsigned, const Class_Selection&);

void write_features(Xml_Writer& writer, const zmlr::Meta_Class& meta_class, bool methods, const Class_Selection& selection)
{
    const Writer_Of_Feature write = methods ? write_method : write_property;
    for (unsigned i = 0; i < meta_class.num_meta_features; ++i)
        if (zmlr::is_method(meta_class.meta_features[i]) == methods && is_selected(meta_class, i, selection))
            write(writer, meta_class, i, selection);
}

} // namespace

void write_class(Xml_Writer& writer, const zmlr::Meta_Class& meta_class, const Class_Selection& selection)
{
    writer.start("CLASS").attribute("NAME", meta_class.name);
    if (meta_class.super_meta_class)
        writer.attribute("SUPERCLASS", meta_class.super_meta_class->name);
    if (selection.qualifiers)
        write_class_qualifiers(writer, meta_class);
    write_features(writer, meta_class, false, selection);
    write_features(writer, meta_class, true, selection);
    writer.end();
}

} // namespace cimserver
