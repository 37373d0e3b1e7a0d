#include "cimserver/cimxml/xml_tree.h"

#include "cimserver/cimxml/http_message.h"

#include <libxml/parser.h>

#include <cstddef>
#include <cstdint>
#include <memory>
#include <mutex>
#include <new>

namespace cimserver
{
namespace
{

const char* chars(const xmlChar* text) { return reinterpret_cast<const char*>(text); }

// Builds the tree from the parser's events. The open elements stand in a list, so neither building nor refusing recurses.
struct Tree_Builder
{
    xmlParserCtxtPtr parser = nullptr;
    std::vector<Xml_Element> open{Xml_Element()}; // the first one holds the root
    std::size_t elements = 0;
    bool refused = false;
    bool out_of_memory = false;

    void refuse()
    {
        refused = true;
        xmlStopParser(parser);
    }
};

// Runs an event on the builder; nothing may leave it as an exception, the parser is C.
template <class Event> void run(void* context, Event event) noexcept
{
    auto* builder = static_cast<Tree_Builder*>(context);
    try
    {
        event(*builder);
    }
    catch (...)
    {
        builder->out_of_memory = true;
        xmlStopParser(builder->parser);
    }
}

Xml_Element make_element(const xmlChar* name, const xmlChar* prefix, int num_attributes, const xmlChar** attributes)
{
    Xml_Element element;
    element.name = prefix ? std::string(chars(prefix)) + ":" + chars(name) : chars(name);
    for (int i = 0; i < num_attributes; ++i)
    {
        const xmlChar** row = attributes + std::ptrdiff_t{5} * i; // name, prefix, URI, start and end of the value
        element.attributes.emplace_back(chars(row[0]), std::string(chars(row[3]), chars(row[4])));
    }
    return element;
}

void start_element(void* context, const xmlChar* name, const xmlChar* prefix, const xmlChar*, int, const xmlChar**,
                   int num_attributes, int, const xmlChar** attributes)
{
    run(context,
        [=](Tree_Builder& builder)
        {
            if (builder.open.size() > max_xml_depth || ++builder.elements > max_xml_elements)
                return builder.refuse();
            builder.open.push_back(make_element(name, prefix, num_attributes, attributes));
        });
}

void end_element(void* context, const xmlChar*, const xmlChar*, const xmlChar*)
{
    run(context,
        [](Tree_Builder& builder)
        {
            Xml_Element element = std::move(builder.open.back());
            builder.open.pop_back();
            builder.open.back().children.push_back(std::move(element));
        });
}

void add_text(void* context, const xmlChar* text, int size)
{
    run(context, [=](Tree_Builder& builder) { builder.open.back().text.append(chars(text), static_cast<std::size_t>(size)); });
}

void refuse_doctype(void* context, const xmlChar*, const xmlChar*, const xmlChar*)
{
    run(context, [](Tree_Builder& builder) { builder.refuse(); });
}

// Keeps the parser from writing to standard error.
void ignore_error(void*, xmlErrorPtr) {}

xmlSAXHandler make_handler()
{
    xmlSAXHandler handler{};
    handler.initialized = XML_SAX2_MAGIC;
    handler.internalSubset = refuse_doctype;
    handler.startElementNs = start_element;
    handler.endElementNs = end_element;
    handler.characters = add_text;
    handler.ignorableWhitespace = add_text;
    handler.cdataBlock = add_text;
    handler.serror = ignore_error;
    return handler;
}

void free_parser(xmlParserCtxtPtr parser)
{
    xmlFreeDoc(parser->myDoc);
    xmlFreeParserCtxt(parser);
}

// The parser guesses other encodings from the first bytes. They are all ruled out by one of these.
bool may_be_utf8(std::string_view document)
{
    constexpr std::string_view first_bytes = "<\xEF \t\r\n";
    return first_bytes.find(document.front()) != std::string_view::npos && document.find('\0') == std::string_view::npos;
}

// The last character of the markup without attributes that begins at i; i itself when none does.
std::size_t end_of_opaque_markup(std::string_view document, std::size_t i)
{
    constexpr std::pair<std::string_view, std::string_view> kinds[] = {{"<![CDATA[", "]]>"}, {"<!--", "-->"}, {"<?", "?>"}};
    for (const auto& [begin, end] : kinds)
        if (document.substr(i).starts_with(begin))
        {
            const std::size_t found = document.find(end, i + begin.size());
            return (found == std::string_view::npos ? document.size() : found + end.size()) - 1;
        }
    return i;
}

// The parser compares each attribute of a tag with each other one, however many there are.
bool has_crowded_tag(std::string_view document)
{
    std::size_t attributes = 0;
    bool in_tag = false;
    char quote = 0;
    for (std::size_t i = 0; i < document.size(); ++i)
    {
        const char c = document[i];
        if (c == '<')
        {
            const std::size_t end = end_of_opaque_markup(document, i);
            in_tag = end == i;
            quote = 0;
            attributes = 0;
            i = end;
        }
        else if (quote != 0)
            quote = c == quote ? '\0' : quote;
        else if (in_tag && (c == '"' || c == '\''))
            quote = c;
        else if (c == '>')
            in_tag = false;
        else if (in_tag && c == '=' && ++attributes > max_xml_attributes)
            return true;
    }
    return false;
}

bool parse(Tree_Builder& builder, std::string_view document)
{
    static std::once_flag initialised;
    std::call_once(initialised, xmlInitParser);

    xmlSAXHandler handler = make_handler();
    const std::unique_ptr<xmlParserCtxt, void (*)(xmlParserCtxtPtr)> parser(
        xmlCreatePushParserCtxt(&handler, &builder, nullptr, 0, nullptr), free_parser);
    if (!parser)
        throw std::bad_alloc();
    builder.parser = parser.get();
    // Without NOENT the parser hands "&amp;" in an attribute on as a reference; there are no other entities to replace.
    xmlCtxtUseOptions(parser.get(), XML_PARSE_NONET | XML_PARSE_NOENT | XML_PARSE_IGNORE_ENC);
    xmlParseChunk(parser.get(), document.data(), static_cast<int>(document.size()), 1);
    return parser->wellFormed == 1;
}

} // namespace

const std::string* Xml_Element::attribute(std::string_view attribute_name) const
{
    for (const auto& [key, value] : attributes)
        if (key == attribute_name)
            return &value;
    return nullptr;
}

const Xml_Element* Xml_Element::child(std::string_view child_name) const
{
    for (const Xml_Element& element : children)
        if (element.name == child_name)
            return &element;
    return nullptr;
}

Xml_Element read_xml(std::string_view document)
{
    if (document.empty() || document.size() > INT32_MAX || !may_be_utf8(document))
        throw Http_Refusal(400, "request-not-well-formed");
    if (has_crowded_tag(document))
        throw Http_Refusal(400, "request-not-valid");
    Tree_Builder builder;
    const bool well_formed = parse(builder, document);
    if (builder.out_of_memory)
        throw std::bad_alloc();
    if (builder.refused)
        throw Http_Refusal(400, "request-not-valid");
    if (!well_formed || builder.open.size() != 1 || builder.open.front().children.size() != 1)
        throw Http_Refusal(400, "request-not-well-formed");
    return std::move(builder.open.front().children.front());
}

} // namespace cimserver
