#include "inventory/property_text.h"

#include <algorithm>
#include <cstring>

namespace zmlr
{

namespace
{

constexpr bool is_continuation(unsigned char byte) { return (byte & 0xC0) == 0x80; }

constexpr bool is_xml_char(uint32 code)
{
    return code == 0x09 || code == 0x0A || code == 0x0D || (code >= 0x20 && code <= 0xD7FF) ||
           (code >= 0xE000 && code <= 0xFFFD) || (code >= 0x10000 && code <= 0x10FFFF);
}

// The bytes that the sequence at the front of the text is made of, by its first byte; 0 when none can begin with it.
constexpr std::size_t sequence_length(unsigned char first)
{
    if (first < 0x80)
        return 1;
    if (first >= 0xC2 && first <= 0xDF)
        return 2;
    if ((first & 0xF0) == 0xE0)
        return 3;
    return first >= 0xF0 && first <= 0xF4 ? 4 : 0;
}

// The length of the XML character at the front of the text, 0 when there is none.
std::size_t character_length(const unsigned char* text, std::size_t size)
{
    constexpr uint32 smallest[] = {0, 0, 0x80, 0x800, 0x10000}; // anything below is written too long
    const std::size_t length = sequence_length(text[0]);
    if (length == 0 || length > size)
        return 0;

    uint32 code = length == 1 ? text[0] : text[0] & (0xFFU >> (length + 1));
    for (std::size_t i = 1; i < length; i++)
    {
        if (!is_continuation(text[i]))
            return 0;
        code = code << 6 | (text[i] & 0x3FU);
    }
    return code >= smallest[length] && is_xml_char(code) ? length : 0;
}

} // namespace

String property_text(const char* field, std::size_t size)
{
    const auto* text = reinterpret_cast<const unsigned char*>(field);
    const std::size_t end = strnlen(field, size);
    String result(field, end);
    for (std::size_t i = 0; i < end;)
    {
        const std::size_t length = character_length(text + i, end - i);
        if (length == 0)
            result.set(static_cast<uint32>(i), '?');
        i += std::max<std::size_t>(length, 1);
    }
    return result;
}

void copy_text(char* out, std::size_t out_size, const char* field, std::size_t size)
{
    const std::size_t length = std::min(strnlen(field, size), out_size - 1);
    std::memcpy(out, field, length);
    out[length] = '\0';
}

} // namespace zmlr
