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

// The address of a port in the fabric as it goes over the wire (FC-FS-2): domain, area, port.
using Fc_Address = std::array<std::uint8_t, 3>;

inline Fc_Address wire_address(std::uint32_t address)
{
    return {static_cast<std::uint8_t>(address >> 16), static_cast<std::uint8_t>(address >> 8),
            static_cast<std::uint8_t>(address)};
}

// In a record such an address lies as on the wire, from the lowest memory address on, and a 0 behind it.
inline std::uint32_t address_field(std::uint32_t address)
{
    std::uint32_t field = 0;
    const auto bytes = wire_address(address);
    std::memcpy(&field, bytes.data(), bytes.size());
    return field;
}

} // namespace hxasim
