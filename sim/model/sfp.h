// The pluggable transceiver of a simulated port.
#pragma once

#include "hxal/records/sfp.h"

#include <cstdint>
#include <string>
#include <string_view>

namespace hxasim
{

struct Sfp_Module
{
    bool present = true;
    hxa_defs_sfp_media_t media = HXA_SFP_MEDIA_SW;
    sfp_mem_t memory{};
};

// A short wave module for links of `speed` Gbit/s, 10: Ethernet, in good health.
Sfp_Module usual_sfp(std::uint32_t speed, const std::string& serial);

// Sets the checksums of the memory.
void seal(sfp_mem_t& memory);

// Whether its memory says that it can do a speed (hxa_pport_speed_t).
bool supports(const Sfp_Module& module, std::uint32_t speed);

// A text padded with blanks, as the memory keeps it.
template <std::size_t size> void put_padded(std::uint8_t (&field)[size], std::string_view text)
{
    for (std::size_t i = 0; i < size; ++i)
        field[i] = i < text.size() ? static_cast<std::uint8_t>(text[i]) : std::uint8_t{' '};
}

// A number of two bytes, most significant first.
inline void put_word(std::uint8_t (&field)[2], int value)
{
    field[0] = static_cast<std::uint8_t>(value >> 8);
    field[1] = static_cast<std::uint8_t>(value);
}

} // namespace hxasim
