#include "sim/commands/scsi_lun.h"

#include <algorithm>

namespace hxasim
{

namespace
{

constexpr std::uint8_t method = 0xC0; // bits of the first byte
constexpr std::uint8_t peripheral_method = 0x00;
constexpr std::uint8_t flat_method = 0x40;
constexpr std::uint8_t extended_flat = 0xD2; // a LUN of three bytes follows

} // namespace

Lun_Bytes lun_of(std::uint32_t number, bool flat)
{
    const auto byte = [=](unsigned shift) { return static_cast<std::uint8_t>(number >> shift); };
    if (number < 256 && !flat)
        return {0, byte(0)};
    if (number < 16384)
        return {static_cast<std::uint8_t>(flat_method | byte(8)), byte(0)};
    return {extended_flat, byte(16), byte(8), byte(0)};
}

std::optional<std::uint32_t> unit_number(const Lun_Bytes& lun)
{
    const bool extended = lun[0] == extended_flat;
    if (std::any_of(lun.begin() + (extended ? 4 : 2), lun.end(), [](std::uint8_t byte) { return byte != 0; }))
        return std::nullopt;
    if (extended)
        return std::uint32_t{lun[1]} << 16 | std::uint32_t{lun[2]} << 8 | lun[3];
    const bool flat = (lun[0] & method) == flat_method;
    if (!flat && lun[0] != peripheral_method)
        return std::nullopt;
    return (lun[0] & ~std::uint32_t{method}) << 8 | lun[1];
}

} // namespace hxasim
