#include "text/characters.h"

namespace text
{
namespace
{

// The bytes of the sequence that a byte begins; 0 when none can begin with it.
constexpr std::size_t sequence_size(unsigned char lead)
{
    if (lead < 0x80)
        return 1;
    if (lead >= 0xC2 && lead <= 0xDF)
        return 2;
    if ((lead & 0xF0U) == 0xE0)
        return 3;
    return lead >= 0xF0 && lead <= 0xF4 ? 4 : 0;
}

constexpr bool is_character(char32_t code, std::size_t size)
{
    constexpr char32_t smallest[] = {0, 0, 0x80, 0x800, 0x10000}; // anything below is written too long
    return code >= smallest[size] && code <= 0x10FFFF && (code < 0xD800 || code > 0xDFFF);
}

constexpr bool is_xml_character(char32_t code)
{
    return code >= 0x20 ? code != 0xFFFE && code != 0xFFFF : code == '\t' || code == '\n' || code == '\r';
}

} // namespace

Character first_character(std::string_view text)
{
    const auto byte = [&](std::size_t i) { return static_cast<unsigned char>(text[i]); };
    const std::size_t size = text.empty() ? 0 : sequence_size(byte(0));
    if (size == 0 || size > text.size())
        return {0, 0};

    char32_t code = size == 1 ? byte(0) : byte(0) & (0x7FU >> size);
    for (std::size_t i = 1; i < size; ++i)
    {
        if ((byte(i) & 0xC0U) != 0x80)
            return {0, 0};
        code = code << 6U | (byte(i) & 0x3FU);
    }
    return is_character(code, size) ? Character{code, size} : Character{0, 0};
}

std::size_t xml_character_size(std::string_view text)
{
    if (!text.empty() && text[0] >= ' ' && text[0] <= '~') // most are
        return 1;
    const Character character = first_character(text);
    return is_xml_character(character.code) ? character.size : 0;
}

std::string utf8_of(char16_t code)
{
    const auto byte = [](unsigned bits) { return static_cast<char>(static_cast<unsigned char>(bits)); };
    if (code < 0x80)
        return {byte(code)};
    if (code < 0x800)
        return {byte(0xC0U | code >> 6U), byte(0x80U | (code & 0x3FU))};
    return {byte(0xE0U | code >> 12U), byte(0x80U | (code >> 6U & 0x3FU)), byte(0x80U | (code & 0x3FU))};
}

} // namespace text
