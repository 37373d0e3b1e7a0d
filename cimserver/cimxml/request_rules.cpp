#include "cimserver/cimxml/request_rules.h"

#include "cimserver/cimxml/http_message.h"
#include "cimserver/model/value_reader.h"

#include <algorithm>
#include <array>
#include <iterator>

namespace cimserver
{
namespace
{

enum class Content
{
    elements, // only the children listed
    text,     // character data only
    opaque    // whatever it holds is for operations that are not served, or says nothing that counts
};

struct Rule
{
    std::string_view element;
    Content content;
    std::size_t min_children;
    std::size_t max_children;
    std::array<std::string_view, 9> children;
    std::array<std::string_view, 2> attributes; // the required ones
};

constexpr std::size_t any = max_xml_elements;

// In the order of DSP0201: values, names and paths, object definitions, messages.
// clang-format off
constexpr Rule rules[] = {
    {"VALUE",                 Content::text,     0, 0,   {}, {}},
    {"VALUE.ARRAY",           Content::elements, 0, any, {"VALUE", "VALUE.NULL"}, {}},
    {"VALUE.REFERENCE",       Content::elements, 1, 1,   {"CLASSPATH", "LOCALCLASSPATH", "CLASSNAME", "INSTANCEPATH",
                                                          "LOCALINSTANCEPATH", "INSTANCENAME"}, {}},
    {"VALUE.REFARRAY",        Content::elements, 0, any, {"VALUE.REFERENCE", "VALUE.NULL"}, {}},
    {"VALUE.NULL",            Content::elements, 0, 0,   {}, {}},
    {"VALUE.NAMEDINSTANCE",   Content::elements, 2, 2,   {"INSTANCENAME", "INSTANCE"}, {}},
    {"NAMESPACEPATH",         Content::elements, 2, 2,   {"HOST", "LOCALNAMESPACEPATH"}, {}},
    {"LOCALNAMESPACEPATH",    Content::elements, 1, any, {"NAMESPACE"}, {}},
    {"HOST",                  Content::text,     0, 0,   {}, {}},
    {"NAMESPACE",             Content::elements, 0, 0,   {}, {"NAME"}},
    {"CLASSPATH",             Content::elements, 2, 2,   {"NAMESPACEPATH", "CLASSNAME"}, {}},
    {"LOCALCLASSPATH",        Content::elements, 2, 2,   {"LOCALNAMESPACEPATH", "CLASSNAME"}, {}},
    {"CLASSNAME",             Content::elements, 0, 0,   {}, {"NAME"}},
    {"INSTANCEPATH",          Content::elements, 2, 2,   {"NAMESPACEPATH", "INSTANCENAME"}, {}},
    {"LOCALINSTANCEPATH",     Content::elements, 2, 2,   {"LOCALNAMESPACEPATH", "INSTANCENAME"}, {}},
    {"INSTANCENAME",          Content::elements, 0, 64,  {"KEYBINDING", "KEYVALUE", "VALUE.REFERENCE"}, {"CLASSNAME"}},
    {"KEYBINDING",            Content::elements, 1, 1,   {"KEYVALUE", "VALUE.REFERENCE"}, {"NAME"}},
    {"KEYVALUE",              Content::text,     0, 0,   {}, {}},
    {"CLASS",                 Content::opaque,   0, 0,   {}, {}},
    {"INSTANCE",              Content::elements, 0, any, {"QUALIFIER", "PROPERTY", "PROPERTY.ARRAY", "PROPERTY.REFERENCE"},
                                                         {"CLASSNAME"}},
    {"QUALIFIER",             Content::opaque,   0, 0,   {}, {}},
    {"PROPERTY",              Content::elements, 0, any, {"QUALIFIER", "VALUE"}, {"NAME", "TYPE"}},
    {"PROPERTY.ARRAY",        Content::elements, 0, any, {"QUALIFIER", "VALUE.ARRAY"}, {"NAME", "TYPE"}},
    {"PROPERTY.REFERENCE",    Content::elements, 0, any, {"QUALIFIER", "VALUE.REFERENCE"}, {"NAME"}},
    {"QUALIFIER.DECLARATION", Content::opaque,   0, 0,   {}, {}},
    {"CIM",                   Content::elements, 1, 1,   {"MESSAGE"}, {"CIMVERSION", "DTDVERSION"}},
    {"MESSAGE",               Content::elements, 1, 1,   {"SIMPLEREQ", "MULTIREQ"}, {"ID", "PROTOCOLVERSION"}},
    {"MULTIREQ",              Content::opaque,   0, 0,   {}, {}},
    {"SIMPLEREQ",             Content::elements, 1, any, {"CORRELATOR", "METHODCALL", "IMETHODCALL"}, {}},
    {"CORRELATOR",            Content::opaque,   0, 0,   {}, {}},
    {"METHODCALL",            Content::elements, 1, any, {"LOCALCLASSPATH", "LOCALINSTANCEPATH", "PARAMVALUE"}, {"NAME"}},
    {"PARAMVALUE",            Content::elements, 0, 1,   {"VALUE", "VALUE.REFERENCE", "VALUE.ARRAY", "VALUE.REFARRAY", "CLASSNAME",
                                                          "INSTANCENAME", "CLASS", "INSTANCE", "VALUE.NAMEDINSTANCE"}, {"NAME"}},
    {"IMETHODCALL",           Content::elements, 1, any, {"LOCALNAMESPACEPATH", "IPARAMVALUE"}, {"NAME"}},
    {"IPARAMVALUE",           Content::elements, 0, 1,   {"VALUE", "VALUE.ARRAY", "VALUE.REFERENCE", "CLASSNAME", "INSTANCENAME",
                                                          "QUALIFIER.DECLARATION", "CLASS", "INSTANCE", "VALUE.NAMEDINSTANCE"}, {"NAME"}},
};
// clang-format on

[[noreturn]] void refuse() { throw Http_Refusal(400, "request-not-valid"); }

const Rule& rule_of(std::string_view name)
{
    const auto* rule = std::ranges::find(rules, name, &Rule::element);
    if (rule == std::end(rules))
        refuse();
    return *rule;
}

void check_attributes(const Xml_Element& element, const Rule& rule)
{
    for (std::string_view name : rule.attributes)
        if (!name.empty() && !element.attribute(name))
            refuse();
}

void check_children(const Xml_Element& element, const Rule& rule)
{
    if (element.children.size() < rule.min_children || element.children.size() > rule.max_children)
        refuse();
    for (const Xml_Element& child : element.children)
    {
        if (std::ranges::find(rule.children, child.name) == rule.children.end())
            refuse();
        check_rules(child);
    }
}

} // namespace

void check_rules(const Xml_Element& element)
{
    const Rule& rule = rule_of(element.name);
    check_attributes(element, rule);
    if (rule.content == Content::opaque)
        return;
    if (rule.content == Content::elements && !trimmed(element.text).empty())
        refuse();
    check_children(element, rule);
}

} // namespace cimserver
