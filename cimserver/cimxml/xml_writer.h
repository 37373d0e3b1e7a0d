// Appends XML to one growing text, in the plain form that every CIM client reads: elements always have an end tag, there
// are no comments, no CDATA and no numeric character references.
//
// Texts may hold any bytes. What is no UTF-8 or what no XML 1.0 document can carry becomes '?', one for each byte. A tab or
// a line break stays in content and becomes a space in an attribute, where a reader would turn it into one anyway.
#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace cimserver
{

class Xml_Writer
{
public:
    Xml_Writer() = default;
    explicit Xml_Writer(std::string head) : _text(std::move(head)) {} // appends to it

    // Opens an element; its attributes follow before anything else. The name must be a literal.
    Xml_Writer& start(const char* name);
    Xml_Writer& attribute(std::string_view name, std::string_view value);
    Xml_Writer& text(std::string_view value);
    Xml_Writer& end(); // closes the innermost open element

    // An element that holds a text and nothing else.
    Xml_Writer& element(const char* name, std::string_view value) { return start(name).text(value).end(); }

    std::string take() { return std::move(_text); }

private:
    void close_tag();

    std::string _text;
    std::vector<const char*> _open;
    bool _in_tag = false;
};

} // namespace cimserver
