#include "inventory/property_text.h"

#include "text/characters.h"

#include <algorithm>
#include <cstring>

namespace zmlr
{

String property_text(const char* field, std::size_t size)
{
    const std::string_view bytes(field, strnlen(field, size));
    String result(field, bytes.size());
    for (std::size_t i = 0; i < bytes.size();)
    {
        const std::size_t length = text::xml_character_size(bytes.substr(i));
        if (length == 0 || bytes[i] == '\r')
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
