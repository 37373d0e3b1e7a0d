#include "cimserver/cimxml/qualifier_writer.h"

#include "cimserver/model/meta_search.h"
#include "cimserver/model/names.h"
#include "cimserver/model/qualifier_table.h"

#include <span>
#include <sstream>
#include <string>

namespace cimserver
{
namespace
{

using Declaration = Qualifier_Declaration;

std::span<const Declaration> declarations() { return {qualifier_declarations, num_qualifier_declarations}; }

void start(Xml_Writer& writer, const char* element, const Declaration& row)
{
    writer.start(element).attribute("NAME", row.name).attribute("TYPE", row.type);
    if (!row.overridable)
        writer.attribute("OVERRIDABLE", "false");
    if (!row.to_subclass)
        writer.attribute("TOSUBCLASS", "false");
    if (row.translatable)
        writer.attribute("TRANSLATABLE", "true");
}

void write_qualifier(Xml_Writer& writer, std::string_view name, std::string_view value)
{
    start(writer, "QUALIFIER", *find_named(declarations(), name));
    writer.element("VALUE", value).end();
}

void write_flags(Xml_Writer& writer, zmlr::uint32 flags)
{
    for (const Declaration& row : declarations())
        if ((flags & row.flag) != 0)
            write_qualifier(writer, row.name, "true");
}

void write_declaration(Xml_Writer& writer, const Declaration& row)
{
    start(writer, "QUALIFIER.DECLARATION", row);
    writer.attribute("ISARRAY", row.array ? "true" : "false").start("SCOPE");
    std::istringstream scopes(row.scopes);
    for (std::string scope; scopes >> scope;)
        writer.attribute(scope, "true");
    writer.end();
    if (row.value)
        writer.element("VALUE", row.value);
    writer.end();
}

using Rows = std::span<const Qualifier_Row>;

// The table's rows by class: rows of one class stand together.
Name_Map<Rows> make_index()
{
    Name_Map<Rows> index;
    const Rows table(qualifier_table, qualifier_table_size);
    for (std::size_t first = 0; first < table.size();)
    {
        std::size_t last = first + 1;
        while (last < table.size() && equal_names(table[last].class_name, table[first].class_name))
            ++last;
        index.emplace(table[first].class_name, table.subspan(first, last - first));
        first = last;
    }
    return index;
}

// The rows of one class and its own features, without its ancestors'.
Rows rows_of(std::string_view class_name)
{
    static const Name_Map<Rows> index = make_index();
    const auto entry = index.find(class_name);
    return entry == index.end() ? Rows() : entry->second;
}

void write_row(Xml_Writer& writer, const Qualifier_Row& row)
{
    const std::span<const char* const> texts(row.values, row.num_values);
    start(writer, "QUALIFIER", *find_named(declarations(), row.name));
    if (row.array)
        writer.start("VALUE.ARRAY");
    for (const char* value : texts)
        writer.element("VALUE", value);
    if (row.array)
        writer.end();
    writer.end();
}

void write_rows(Xml_Writer& writer, const zmlr::Meta_Class& meta_class, std::string_view feature, std::string_view parameter = "")
{
    for (const Qualifier_Row& row : rows_of(meta_class.name))
        if (equal_names(row.feature_name, feature) && equal_names(row.parameter_name, parameter))
            write_row(writer, row);
}

bool overrides(const zmlr::Meta_Class& meta_class, unsigned index)
{
    const zmlr::Meta_Class* super = meta_class.super_meta_class;
    return super && is_local(meta_class, index) &&
           feature_index(*super, meta_class.meta_features[index]->name) < super->num_meta_features;
}

} // namespace

void write_class_qualifiers(Xml_Writer& writer, const zmlr::Meta_Class& meta_class)
{
    write_flags(writer, meta_class.flags);
    write_rows(writer, meta_class, "");
}

void write_feature_qualifiers(Xml_Writer& writer, const zmlr::Meta_Class& meta_class, unsigned index)
{
    const zmlr::Meta_Feature& feature = *meta_class.meta_features[index];
    write_flags(writer, feature.flags);
    if (zmlr::is_property(&feature) && (feature.flags & zmlr::Flag_Read) == 0)
        write_qualifier(writer, "Read", "false");
    if (overrides(meta_class, index))
        write_qualifier(writer, "Override", feature.name);
    if (const zmlr::Meta_Class* origin = describing_class_of(meta_class, feature.name))
        write_rows(writer, *origin, feature.name);
}

void write_parameter_qualifiers(Xml_Writer& writer, const zmlr::Meta_Class& meta_class, const zmlr::Meta_Method& method,
                                const zmlr::Meta_Feature& parameter)
{
    write_qualifier(writer, "In", (parameter.flags & zmlr::Flag_In) != 0 ? "true" : "false");
    write_flags(writer, parameter.flags);
    if (const zmlr::Meta_Class* origin = describing_class_of(meta_class, method.name))
        write_rows(writer, *origin, method.name, parameter.name);
}

void write_qualifier_declarations(Xml_Writer& writer)
{
    for (const Declaration& row : declarations())
        write_declaration(writer, row);
}

bool write_qualifier_declaration(Xml_Writer& writer, std::string_view name)
{
    const Declaration* row = find_named(declarations(), name);
    if (row)
        write_declaration(writer, *row);
    return row != nullptr;
}

} // namespace cimserver
