// The texts of the configuration file, as views: what the helpers of hxal/config/syntax.h do, without a buffer to overrun.
#pragma once

#include "hxal/records/types.h"

#include <algorithm>
#include <optional>
#include <string_view>

namespace hxal::config
{

inline std::string_view view_of(const char* text) { return text ? text : std::string_view(); }

// Without blanks, tabs, double quotes, semicolons and newlines at both ends; one blank when nothing is left.
std::string_view filtered(std::string_view text);

// From behind the first "-" (start '-') or the beginning, to the first `end`. Neither may be missing, nor what is between.
std::optional<std::string_view> raw_key(char start, char end, std::string_view line);

// Behind the first `token`.
std::optional<std::string_view> raw_data(char token, std::string_view line);

// The decimal number at the end, at most INT_MAX.
int number(std::string_view text);

// Whether there is a digit for number() to read.
bool has_number(std::string_view text);

uint32_t hexadecimal(std::string_view text, uint32_t value = 0);
wwn_t wwn_of(std::string_view text);

// Calls `part` with what stands between the separators, empty parts too.
template <typename Part> void split(std::string_view text, char separator, Part part)
{
    for (std::size_t end = text.find(separator); end != text.npos; end = text.find(separator))
    {
        part(text.substr(0, end));
        text.remove_prefix(end + 1);
    }
    part(text);
}

// The bitmap of a list of numbers separated by ",". A part without any text is no number: what is written of an empty list is
// an empty list again.
uint32_t bitmap(std::string_view list);

// Copies into a field, cut where it does not fit, and fills the rest with zeros.
template <std::size_t Size> void copy(char (&field)[Size], std::string_view text)
{
    const std::size_t length = std::min(text.size(), Size - 1);
    std::fill(std::copy_n(text.begin(), length, field), field + Size, '\0');
}

// WWNs and MACs as the file has them: bytes in memory order, two lower-case hexadecimal digits each, ":" between.
constexpr std::size_t wwn_text_size = 24;
constexpr std::size_t mac_text_size = 18;
void write_wwn(char (&text)[wwn_text_size], wwn_t wwn);
void write_mac(char (&text)[mac_text_size], const mac_t& mac);

} // namespace hxal::config
