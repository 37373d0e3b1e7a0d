// A strict reader of small XML documents from strangers.
//
// No DOCTYPE, hence no entities but the five predefined ones and nothing to fetch; elements only, comments and processing
// instructions are dropped. The document is read as UTF-8, whatever encoding it declares. Time and memory are bounded by its
// size and by the limits below.
#pragma once

#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace cimserver
{

inline constexpr std::size_t max_xml_depth = 32;
inline constexpr std::size_t max_xml_elements = 20000;
inline constexpr std::size_t max_xml_attributes = 256; // of one element

struct Xml_Element
{
    std::string name;
    std::vector<std::pair<std::string, std::string>> attributes; // name, value
    std::string text;                                            // all character data directly inside, CDATA too
    std::vector<Xml_Element> children;

    const std::string* attribute(std::string_view attribute_name) const; // null when absent
    const Xml_Element* child(std::string_view child_name) const;         // the first of that name; null when absent
};

// The document's root element. Throws Http_Refusal 400 "request-not-well-formed" when the document is no
// well-formed XML, and "request-not-valid" for a DOCTYPE and for what passes a limit.
Xml_Element read_xml(std::string_view document);

} // namespace cimserver
