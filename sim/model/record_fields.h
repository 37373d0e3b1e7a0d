// Putting values into the fixed fields of records.
#pragma once

#include "hxal/records/aen.h"

#include <algorithm>
#include <array>
#include <cstring>
#include <string>
#include <string_view>

namespace hxasim
{

// The longest record of all: a fetch of as many events as there may be.
constexpr std::size_t max_record_size = sizeof(hxal_ioctl_aen_t);

// A text that fills its field has no terminator; the rest of the field becomes 0.
template <std::size_t size> void put_text(char (&field)[size], std::string_view text)
{
    std::memset(field, 0, size);
    std::memcpy(field, text.data(), std::min(size, text.size()));
}

// The text of a field that may lack its terminator.
template <std::size_t size> std::string get_text(const char (&field)[size]) { return {field, strnlen(field, size)}; }

inline void put_address(wwn_t& field, const std::array<std::uint8_t, 8>& wwn) { std::memcpy(&field, wwn.data(), wwn.size()); }
inline void put_address(mac_t& field, const std::array<std::uint8_t, 6>& mac) { std::memcpy(field.mac, mac.data(), mac.size()); }

} // namespace hxasim
