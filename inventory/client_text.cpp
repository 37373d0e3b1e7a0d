#include "inventory/client_text.h"

#include "text/characters.h"

#include <algorithm>
#include <string_view>

namespace zmlr
{

namespace
{

constexpr std::size_t log_text_size = 4096;

bool is_control(char32_t code) { return code < 0x20 || (code >= 0x7F && code < 0xA0); }

} // namespace

bool has_control_character(const String& text)
{
    for (std::string_view rest(text.c_str(), text.size()); !rest.empty();)
    {
        const text::Character first = text::first_character(rest);
        if (first.size > 0 && is_control(first.code))
            return true;
        rest.remove_prefix(std::max<std::size_t>(first.size, 1));
    }
    return false;
}

String log_text(const String& text)
{
    String line;
    for (std::string_view rest(text.c_str(), text.size()); !rest.empty() && line.size() < log_text_size;)
    {
        const text::Character first = text::first_character(rest);
        if (first.size == 0 || is_control(first.code))
            line.append('?');
        else
            line.append(rest.data(), first.size);
        rest.remove_prefix(std::max<std::size_t>(first.size, 1));
    }
    return line;
}

} // namespace zmlr
