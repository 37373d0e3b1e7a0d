// The flash of a simulated card: partitions that keep what is written to them.
#pragma once

#include "hxal/records/flash.h"

#include <cstdint>
#include <span>
#include <vector>

namespace hxasim
{

struct Flash_Partition
{
    std::uint32_t type;     // hxa_flash_part_type_t
    std::uint32_t instance; // of the type
    std::uint32_t size;
    std::uint32_t status = HXA_FLASH_STATUS_EMPTY; // hxa_flash_status_t
    std::vector<std::uint8_t> data = {};           // what was written; behind it the flash is erased
};

// What flash holds where nothing was written.
constexpr std::uint8_t erased = 0xFF;

struct Flash
{
    std::vector<Flash_Partition> partitions; // at most 16, one behind the other
    bool optrom_enabled = true;

    Flash_Partition* find(std::uint32_t type, std::uint32_t instance); // null when there is none
};

// The partitions of a new card with this many ports: good boot code, all others erased.
Flash usual_flash(std::size_t ports);

// Writes from the start of the partition; the rest of it becomes erased. A partition whose status is HXA_FLASH_STATUS_BAD
// keeps nothing. False when the bytes do not fit.
bool write(Flash_Partition& partition, std::span<const std::uint8_t> bytes);

void erase(Flash_Partition& partition);

// Reads from the start of the partition. False when it is shorter.
bool read(const Flash_Partition& partition, std::span<std::uint8_t> bytes);

} // namespace hxasim
