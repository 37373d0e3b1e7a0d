#include "text/safe_text.h"

#include "text/characters.h"

#include <algorithm>

namespace text
{
namespace
{

bool is_steering(char32_t code)
{
    const auto within = [=](char32_t first, char32_t last) { return code >= first && code <= last; };
    return code < 0x20 || within(0x7F, 0x9F) || within(0x200B, 0x200F) || within(0x2028, 0x202E) || within(0x2060, 0x206F) ||
           code == 0xFEFF || code == 0x061C || code >= 0xE0000;
}

// Printable ASCII at the front needs no closer look: most texts are nothing else.
std::size_t plain_size(std::string_view text)
{
    const auto* end = std::find_if(text.begin(), text.end(), [](char c) { return c < ' ' || c > '~'; });
    return static_cast<std::size_t>(end - text.begin());
}

// The bytes at the front that stay as they are; 0 when what stands there must not.
std::size_t safe_size(std::string_view text, std::string_view kept)
{
    if (const std::size_t size = plain_size(text); size > 0)
        return size;
    if (kept.find(text.front()) != kept.npos)
        return 1;
    const Character first = first_character(text);
    return is_steering(first.code) ? 0 : first.size;
}

std::size_t step(std::string_view text) { return std::max<std::size_t>(first_character(text).size, 1); }

} // namespace

bool holds_steering(std::string_view text)
{
    for (; !text.empty(); text.remove_prefix(step(text)))
    {
        const Character first = first_character(text);
        if (first.size > 0 && is_steering(first.code))
            return true;
    }
    return false;
}

std::string safe_text(std::string_view text, std::string_view kept)
{
    std::string safe;
    while (!text.empty())
    {
        const std::size_t size = safe_size(text, kept);
        safe += size > 0 ? text.substr(0, size) : "?";
        text.remove_prefix(size > 0 ? size : step(text));
    }
    return safe;
}

} // namespace text
