#include "cimserver/cimxml/xml_writer.h"

#include <cstdint>

namespace cimserver
{

namespace
{

enum class Place
{
    content,
    attribute
};

unsigned byte_at(std::string_view text, std::size_t i) { return static_cast<unsigned char>(text[i]); }

// Bytes of the sequence that a UTF-8 lead byte announces; 0 for a byte that cannot lead.
std::size_t sequence_size(unsigned lead)
{
    if (lead < 0x80)
        return 1;
    if (lead >= 0xC2 && lead <= 0xDF)
        return 2;
    if (lead >= 0xE0 && lead <= 0xEF)
        return 3;
    return lead >= 0xF0 && lead <= 0xF4 ? 4 : 0;
}

// The code point of a sequence of more than one byte, 0 when a continuation byte is missing.
std::uint32_t decode(std::string_view sequence)
{
    std::uint32_t code = byte_at(sequence, 0) & (0x7Fu >> sequence.size());
    for (std::size_t i = 1; i < sequence.size(); ++i)
    {
        if ((byte_at(sequence, i) & 0xC0) != 0x80)
            return 0;
        code = code << 6 | (byte_at(sequence, i) & 0x3F);
    }
    return code;
}

// The production Char of XML 1.0, beyond ASCII and without overlong forms.
bool is_xml_char(std::uint32_t code, std::size_t size)
{
    constexpr std::uint32_t smallest[] = {0, 0, 0x80, 0x800, 0x10000};
    if (code < smallest[size] || code > 0x10FFFF)
        return false;
    return !(code >= 0xD800 && code <= 0xDFFF) && code != 0xFFFE && code != 0xFFFF;
}

// The size of the good multi-byte character at i, 0 when there is none.
std::size_t character_at(std::string_view text, std::size_t i)
{
    const std::size_t size = sequence_size(byte_at(text, i));
    if (size < 2 || text.size() - i < size)
        return 0;
    return is_xml_char(decode(text.substr(i, size)), size) ? size : 0;
}

// What stands for an ASCII character that cannot stay as it is; empty for one that can.
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
        return static_cast<unsigned char>(c) < 0x20 ? "?" : "";
    }
}

void append(std::string& out, std::string_view text, Place place)
{
    std::size_t plain = 0; // start of what can be copied as it is
    for (std::size_t i = 0; i < text.size();)
    {
        const bool ascii = byte_at(text, i) < 0x80;
        const std::size_t size = ascii ? 1 : character_at(text, i);
        const std::string_view instead = ascii ? replacement(text[i], place) : size == 0 ? "?" : "";
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
