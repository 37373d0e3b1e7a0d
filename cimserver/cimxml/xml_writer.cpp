#include "cimserver/cimxml/xml_writer.h"

#include "text/characters.h"

namespace cimserver
{
namespace
{

enum class Place
{
    content,
    attribute
};

// What stands for a character that cannot stay as it is; empty for one that can.
std::string_view replacement(char c, Place place)
{
    switch (c)
    {
    case '&':
        return "&amp;";
    case '<':
        return "&lt;";
    case '>':
        return "&gt;";
    case '"':
        return "&quot;";
    case '\'':
        return "&apos;";
    case '\t':
    case '\n':
    case '\r':
        return place == Place::attribute ? " " : "";
    default:
        return "";
    }
}

void append(std::string& out, std::string_view text, Place place)
{
    std::size_t plain = 0; // start of what can be copied as it is
    for (std::size_t i = 0; i < text.size();)
    {
        const std::size_t size = text::xml_character_size(text.substr(i));
        const std::string_view instead = size == 0 ? "?" : replacement(text[i], place);
        if (!instead.empty())
        {
            out.append(text, plain, i - plain).append(instead);
            plain = i + 1;
        }
        i += size == 0 ? 1 : size;
    }
    out.append(text, plain);
}

} // namespace

Xml_Writer& Xml_Writer::start(const char* name)
{
    close_tag();
    _text.append(1, '<').append(name);
    _open.push_back(name);
    _in_tag = true;
    return *this;
}

Xml_Writer& Xml_Writer::attribute(std::string_view name, std::string_view value)
{
    _text.append(1, ' ').append(name).append("=\"");
    append(_text, value, Place::attribute);
    _text.append(1, '"');
    return *this;
}

Xml_Writer& Xml_Writer::text(std::string_view value)
{
    close_tag();
    append(_text, value, Place::content);
    return *this;
}

Xml_Writer& Xml_Writer::end()
{
    close_tag();
    _text.append("</").append(_open.back()).append(1, '>');
    _open.pop_back();
    return *this;
}

void Xml_Writer::close_tag()
{
    if (_in_tag)
        _text.append(1, '>');
    _in_tag = false;
}

} // namespace cimserver
