#include "runtime/ascii.h"
#include "runtime/string.h"

#include <algorithm>
#include <cstring>

namespace zmlr
{

bool eqi(const char* a, const char* b)
{
    for (; ascii::to_lower(*a) == ascii::to_lower(*b); ++a, ++b)
        if (!*a)
            return true;
    return false;
}

std::size_t strlcpy(char* dst, const char* src, std::size_t size)
{
    const std::size_t length = std::strlen(src);
    if (size > 0)
    {
        const std::size_t n = std::min(length, size - 1);
        std::memcpy(dst, src, n);
        dst[n] = '\0';
    }
    return length;
}

std::size_t strlcat(char* dst, const char* src, std::size_t size)
{
    const std::size_t used = strnlen(dst, size);
    return used == size ? size : used + strlcpy(dst + used, src, size - used);
}

int find_token(const char* text, const char* separators, const char*& start, const char*& end)
{
    const char* first = text + std::strspn(text, separators);
    if (!*first)
        return -1;
    start = first;
    end = first + std::strcspn(first, separators);
    return 0;
}

} // namespace zmlr
