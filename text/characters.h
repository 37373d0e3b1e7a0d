// Characters of UTF-8 texts, and which of them an XML 1.0 document can carry.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace text
{

struct Character
{
    char32_t code;
    std::size_t size; // bytes; 0 when no character stands there
};

// The character at the front of a text. None for an empty text, a byte that begins no sequence, a sequence that is cut or
// written too long, and a code point that is no character (a surrogate, or beyond U+10FFFF).
Character first_character(std::string_view text);

// The bytes of that character when XML 1.0 has it (the production Char: tab, line breaks, and all from U+0020 but surrogates,
// U+FFFE and U+FFFF); else 0.
std::size_t xml_character_size(std::string_view text);

// The UTF-8 of a code point up to U+FFFF.
std::string utf8_of(char16_t code);

} // namespace text
