#include "runtime/number.h"

#include <array>
#include <charconv>

namespace zmlr
{

namespace
{

// The small numbers that most properties hold.
struct Uint_Str
{
    char str[4];
    uint32 size;
};

constexpr std::array<Uint_Str, 128> make_prepared_texts()
{
    std::array<Uint_Str, 128> texts{};
    for (uint32 i = 0; i < texts.size(); ++i)
    {
        Uint_Str& text = texts[i];
        text.size = i < 10 ? 1 : i < 100 ? 2 : 3;
        for (uint32 rest = i, pos = text.size; pos-- > 0; rest /= 10)
            text.str[pos] = static_cast<char>('0' + rest % 10);
    }
    return texts;
}

constexpr std::array<Uint_Str, 128> prepared_texts = make_prepared_texts();

const char* prepared(uint64 x, uint32& size)
{
    size = prepared_texts[x].size;
    return prepared_texts[x].str;
}

// Writes the digits backwards from the buffer's end and returns the first one.
char* write_digits(char (&buffer)[number_text_size], uint64 x)
{
    char* begin = buffer + number_text_size - 1;
    *begin = '\0';
    do
        *--begin = static_cast<char>('0' + x % 10);
    while ((x /= 10) != 0);
    return begin;
}

uint32 size_from(const char (&buffer)[number_text_size], const char* begin)
{
    return static_cast<uint32>(buffer + number_text_size - 1 - begin);
}

} // namespace

const char* uint64_to_str(char (&buffer)[number_text_size], uint64 x, uint32& size)
{
    if (x < prepared_texts.size())
        return prepared(x, size);
    const char* begin = write_digits(buffer, x);
    size = size_from(buffer, begin);
    return begin;
}

const char* sint64_to_str(char (&buffer)[number_text_size], sint64 x, uint32& size)
{
    if (x >= 0)
        return uint64_to_str(buffer, static_cast<uint64>(x), size);
    char* begin = write_digits(buffer, 0 - static_cast<uint64>(x));
    *--begin = '-';
    size = size_from(buffer, begin);
    return begin;
}

const char* uint8_to_str(char (&buffer)[number_text_size], uint8 x, uint32& size) { return uint64_to_str(buffer, x, size); }
const char* uint16_to_str(char (&buffer)[number_text_size], uint16 x, uint32& size) { return uint64_to_str(buffer, x, size); }
const char* uint32_to_str(char (&buffer)[number_text_size], uint32 x, uint32& size) { return uint64_to_str(buffer, x, size); }
const char* sint8_to_str(char (&buffer)[number_text_size], sint8 x, uint32& size) { return sint64_to_str(buffer, x, size); }
const char* sint16_to_str(char (&buffer)[number_text_size], sint16 x, uint32& size) { return sint64_to_str(buffer, x, size); }
const char* sint32_to_str(char (&buffer)[number_text_size], sint32 x, uint32& size) { return sint64_to_str(buffer, x, size); }

const char* real64_to_str(char (&buffer)[real_text_size], real64 x, uint32& size)
{
    char* const end = std::to_chars(buffer, buffer + real_text_size - 1, x, std::chars_format::fixed, 6).ptr;
    *end = '\0';
    size = static_cast<uint32>(end - buffer);
    return buffer;
}

} // namespace zmlr
