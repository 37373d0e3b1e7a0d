#include "text/integers.h"

#include <charconv>
#include <system_error>

namespace text
{

std::optional<std::uint64_t> read_digits(std::string_view digits, int base)
{
    std::uint64_t number = 0;
    const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), number, base);
    if (digits.empty() || error != std::errc() || end != digits.data() + digits.size())
        return std::nullopt;
    return number;
}

std::optional<Integer> read_integer(std::string_view text)
{
    const bool negative = text.starts_with('-');
    if (negative || text.starts_with('+'))
        text.remove_prefix(1);
    const bool hexadecimal = text.starts_with("0x") || text.starts_with("0X");
    const auto magnitude = hexadecimal ? read_digits(text.substr(2), 16) : read_digits(text, 10);
    if (!magnitude)
        return std::nullopt;
    return Integer{negative, *magnitude};
}

bool fits(const Integer& number, unsigned bits, bool is_signed)
{
    const std::uint64_t largest = UINT64_MAX >> (64 - bits + (is_signed ? 1U : 0U));
    if (!number.negative)
        return number.magnitude <= largest;
    return number.magnitude <= (is_signed ? largest + 1 : 0);
}

} // namespace text
