// What a simulated logical unit tells of itself.
#pragma once

#include "sim/model/scsi_target.h"

#include <optional>

namespace hxasim
{

// The standard INQUIRY data, 36 bytes, SPC-3. Null: no such unit.
std::vector<std::uint8_t> standard_inquiry(const Unit_Range* unit);

// A page of vital product data, SPC-3: 0x00, 0x80, 0x83. None when the unit does not have it.
std::optional<std::vector<std::uint8_t>> vital_product_data(const Scsi_Target& target, const Unit_Range& unit,
                                                            std::uint32_t number, std::uint8_t page);

} // namespace hxasim
