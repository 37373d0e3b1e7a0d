// What drivers and devices deliver, as text for a terminal and for JSON.
#pragma once

#include "hxal/records/types.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace hxa
{

// text::safe_text() without blanks at both ends.
std::string safe_text(std::string_view bytes);

// The text of a field, up to its terminator or its end.
template <std::size_t Size> std::string field_text(const char (&field)[Size])
{
    const std::string_view bytes(field, Size);
    return safe_text(bytes.substr(0, bytes.find('\0')));
}
template <std::size_t Size> std::string field_text(const std::uint8_t (&field)[Size])
{
    return field_text(reinterpret_cast<const char(&)[Size]>(field));
}

// 16 upper-case hexadecimal digits, as everywhere in this product; a MAC has 12, an FC address 6.
std::string wwn_text(wwn_t wwn);
std::string mac_text(const mac_t& mac);
std::string address_text(std::uint32_t pid);
std::string hexadecimal(std::uint64_t number, int digits);

// The WWN or MAC that digits of either case write, with ":" between the bytes or without; nothing for any other text.
std::optional<wwn_t> read_wwn(std::string_view text);
std::optional<mac_t> read_mac(std::string_view text);

} // namespace hxa
