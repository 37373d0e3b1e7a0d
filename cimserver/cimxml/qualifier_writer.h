// Writes the qualifiers of classes and their features: those that the meta-data's flags stand for, and the texts of the
// qualifier table (DSP0004, DSP0201).
#pragma once

#include "cimserver/cimxml/xml_writer.h"
#include "runtime/meta.h"

#include <string_view>

namespace cimserver
{

// The table's rows of the class itself, and of a feature those of the class that declares it or last overrides it.
void write_class_qualifiers(Xml_Writer& writer, const zmlr::Meta_Class& meta_class);
void write_feature_qualifiers(Xml_Writer& writer, const zmlr::Meta_Class& meta_class, unsigned feature_index);

// A parameter's direction and flags, and the table's rows of the class that declares the method or last overrides it.
void write_parameter_qualifiers(Xml_Writer& writer, const zmlr::Meta_Class& meta_class, const zmlr::Meta_Method& method,
                                const zmlr::Meta_Feature& parameter);

// QUALIFIER.DECLARATION of each qualifier that the server knows, or of one; false when there is none of that name.
void write_qualifier_declarations(Xml_Writer& writer);
bool write_qualifier_declaration(Xml_Writer& writer, std::string_view name);

} // namespace cimserver
