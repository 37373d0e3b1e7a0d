#include "runtime/ascii.h"
#include "runtime/number.h"
#include "runtime/string.h"
#include "text/integers.h"

#include <cstdlib>
#include <cstring>
#include <limits>
#include <locale.h>

namespace zmlr
{

namespace
{

// Digits up to the text's end: 1 to `most` of them, below 2^64; letters in upper case only.
int read_digits(const char* text, int base, std::size_t most, uint64& x)
{
    const std::string_view digits(text, strnlen(text, most + 1));
    const auto value = digits.size() <= most ? text::read_digits(digits, base) : std::nullopt;
    if (!value || digits.find_first_of("abcdef") != std::string_view::npos)
        return -1;
    x = *value;
    return 0;
}

template <class T, class Wide> int narrow(Wide wide, T& x)
{
    if (wide < std::numeric_limits<T>::min() || wide > std::numeric_limits<T>::max())
        return -1;
    x = static_cast<T>(wide);
    return 0;
}

template <class T> int read_unsigned(const char* text, T& x)
{
    uint64 wide = 0;
    return str_to_uint64(text, wide) == 0 ? narrow(wide, x) : -1;
}

template <class T> int read_signed(const char* text, T& x)
{
    sint64 wide = 0;
    return str_to_sint64(text, wide) == 0 ? narrow(wide, x) : -1;
}

bool is_sign(char c) { return c == '+' || c == '-'; }

const char* skip_digits(const char* text)
{
    while (ascii::is_digit(*text))
        ++text;
    return text;
}

bool is_real(const char* text)
{
    text = skip_digits(is_sign(*text) ? text + 1 : text);
    if (*text != '.' || !ascii::is_digit(*++text))
        return false;
    text = skip_digits(text);
    if (*text != 'e' && *text != 'E')
        return *text == '\0';
    text += is_sign(text[1]) ? 2 : 1;
    return ascii::is_digit(*text) && *skip_digits(text) == '\0';
}

} // namespace

int str_to_boolean(const char* text, boolean& x)
{
    const bool is_true = text && eqi(text, "true");
    if (!is_true && !(text && eqi(text, "false")))
        return -1;
    x = is_true;
    return 0;
}

int str_to_uint64(const char* text, uint64& x)
{
    if (!text)
        return -1;
    const bool hexadecimal = text[0] == '0' && (text[1] == 'x' || text[1] == 'X');
    return hexadecimal ? read_digits(text + 2, 16, 16, x) : read_digits(text, 10, 20, x);
}

int str_to_sint64(const char* text, sint64& x)
{
    if (!text)
        return -1;
    const bool negative = *text == '-';
    const auto limit = static_cast<uint64>(std::numeric_limits<sint64>::max()) + (negative ? 1 : 0);
    uint64 magnitude = 0;
    if (str_to_uint64(is_sign(*text) ? text + 1 : text, magnitude) != 0 || magnitude > limit)
        return -1;
    x = static_cast<sint64>(negative ? 0 - magnitude : magnitude);
    return 0;
}

int str_to_uint8(const char* text, uint8& x) { return read_unsigned(text, x); }
int str_to_uint16(const char* text, uint16& x) { return read_unsigned(text, x); }
int str_to_uint32(const char* text, uint32& x) { return read_unsigned(text, x); }
int str_to_sint8(const char* text, sint8& x) { return read_signed(text, x); }
int str_to_sint16(const char* text, sint16& x) { return read_signed(text, x); }
int str_to_sint32(const char* text, sint32& x) { return read_signed(text, x); }

int str_to_real64(const char* text, real64& x)
{
    if (!text || !is_real(text))
        return -1;
    // A server may have set a locale whose decimal point is a comma.
    const locale_t c_locale = newlocale(LC_ALL_MASK, "C", nullptr);
    if (!c_locale)
        return -1;
    x = strtod_l(text, nullptr, c_locale);
    freelocale(c_locale);
    return 0;
}

int str_to_real32(const char* text, real32& x)
{
    real64 wide = 0;
    if (str_to_real64(text, wide) != 0)
        return -1;
    x = static_cast<real32>(wide);
    return 0;
}

} // namespace zmlr
