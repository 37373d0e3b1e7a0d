// Numbers of logical units as the 8 bytes of a LUN, SAM-4.
#pragma once

#include <array>
#include <cstdint>
#include <optional>

namespace hxasim
{

using Lun_Bytes = std::array<std::uint8_t, 8>;

// Peripheral addressing up to 255 (unless `flat`), flat addressing up to 16383, extended flat addressing from there.
Lun_Bytes lun_of(std::uint32_t number, bool flat);

// The number in any of the three; none when it is something else.
std::optional<std::uint32_t> unit_number(const Lun_Bytes& lun);

} // namespace hxasim
