#include "cimserver/cimxml/qualifier_writer.h"

#include "cimserver/broker/names.h"
#include "cimserver/cimxml/meta_search.h"
#include "cimserver/qualifier_table.h"

#include <span>
#include <string_view>

namespace cimserver
{

namespace
{

// The flavours of DSP0004: whether a subclass may give the qualifier another value, and whether it inherits it.
struct Flavors
{
    bool overridable = true;
    bool to_subclass = true;
    bool translatable = false;
};

struct Flag_Row
{
    zmlr::uint32 flag;
    const char* name;
    Flavors flavors;
};

// The flags that are boolean qualifiers, in bit order. Not here: the kinds of features, In and Read, which are true unless
// said otherwise, and EmbeddedInstance, which names a class: the table has it.
// clang-format off
constexpr Flag_Row flag_rows[] = {
    {zmlr::Flag_Abstract,       "Abstract",       {false, false}},
    {zmlr::Flag_Aggregate,      "Aggregate",      {false, true}},
    {zmlr::Flag_Aggregation,    "Aggregation",    {false, true}},
    {zmlr::Flag_Association,    "Association",    {false, true}},
    {zmlr::Flag_Composition,    "Composition",    {false, true}},
    {zmlr::Flag_Counter,        "Counter",        {}},
    {zmlr::Flag_Delete,         "Delete",         {}},
    {zmlr::Flag_DN,             "DN",             {false, true}},
    {zmlr::Flag_EmbeddedObject, "EmbeddedObject", {false, true}},
    {zmlr::Flag_Exception,      "Exception",      {false, true}},
    {zmlr::Flag_Expensive,      "Expensive",      {}},
    {zmlr::Flag_Experimental,   "Experimental",   {true, false}},
    {zmlr::Flag_Gauge,          "Gauge",          {}},
    {zmlr::Flag_IfDeleted,      "IfDeleted",      {}},
    {zmlr::Flag_Indication,     "Indication",     {false, true}},
    {zmlr::Flag_Invisible,      "Invisible",      {}},
    {zmlr::Flag_Key,            "Key",            {false, true}},
    {zmlr::Flag_Large,          "Large",          {}},
    {zmlr::Flag_OctetString,    "OctetString",    {false, true}},
    {zmlr::Flag_Out,            "Out",            {false, true}},
    {zmlr::Flag_Required,       "Required",       {false, true}},
    {zmlr::Flag_Static,         "Static",         {false, true}},
    {zmlr::Flag_Terminal,       "Terminal",       {false, false}},
    {zmlr::Flag_Weak,           "Weak",           {false, true}},
    {zmlr::Flag_Write,          "Write",          {}},
};
// clang-format on

void start_qualifier(Xml_Writer& writer, const char* name, const char* type, Flavors flavors)
{
    writer.start("QUALIFIER").attribute("NAME", name).attribute("TYPE", type);
    if (!flavors.overridable)
        writer.attribute("OVERRIDABLE", "false");
    if (!flavors.to_subclass)
        writer.attribute("TOSUBCLASS", "false");
    if (flavors.translatable)
        writer.attribute("TRANSLATABLE", "true");
}

void write_boolean(Xml_Writer& writer, const char* name, bool value, Flavors flavors)
{
    start_qualifier(writer, name, "boolean", flavors);
    writer.element("VALUE", value ? "true" : "false").end();
}

void write_text(Xml_Writer& writer, const char* name, std::string_view value, Flavors flavors)
{
    start_qualifier(writer, name, "string", flavors);
    writer.element("VALUE", value).end();
}

void write_flags(Xml_Writer& writer, zmlr::uint32 flags)
{
    for (const Flag_Row& row : flag_rows)
        if ((flags & row.flag) != 0)
            write_boolean(writer, row.name, true, row.flavors);
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

bool is_translatable(std::string_view name) { return equal_names(name, "Description") || equal_names(name, "Values"); }

void write_row(Xml_Writer& writer, const Qualifier_Row& row)
{
    const std::span<const char* const> values(row.values, row.num_values);
    start_qualifier(writer, row.name, "string", {true, true, is_translatable(row.name)});
    if (row.array)
        writer.start("VALUE.ARRAY");
    for (const char* value : values)
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
        write_boolean(writer, "Read", false, {});
    if (overrides(meta_class, index))
        write_text(writer, "Override", feature.name, {true, false});
    if (const zmlr::Meta_Class* origin = describing_class_of(meta_class, feature.name))
        write_rows(writer, *origin, feature.name);
}

void write_parameter_qualifiers(Xml_Writer& writer, const zmlr::Meta_Class& meta_class, const zmlr::Meta_Method& method,
                                const zmlr::Meta_Feature& parameter)
{
    write_boolean(writer, "In", (parameter.flags & zmlr::Flag_In) != 0, {false, true});
    write_flags(writer, parameter.flags);
    if (const zmlr::Meta_Class* origin = describing_class_of(meta_class, method.name))
        write_rows(writer, *origin, method.name, parameter.name);
}

} // namespace cimserver
