#include "sim/model/flash.h"

#include <algorithm>

namespace hxasim
{

namespace
{

constexpr std::uint32_t KiB = 1024;

struct Usual_Partition
{
    std::uint32_t type;
    std::uint32_t size;
    bool per_port;
};

// clang-format off
constexpr Usual_Partition usual_partitions[] = {
    {HXA_FLASH_PART_OPTROM,   512 * KiB,      false},
    {HXA_FLASH_PART_FWIMG,    2 * 1024 * KiB, false},
    {HXA_FLASH_PART_FWCFG,    64 * KiB,       true},
    {HXA_FLASH_PART_MFG,      4 * KiB,        false},
    {HXA_FLASH_PART_VPD,      4 * KiB,        false},
    {HXA_FLASH_PART_PBC,      4 * KiB,        false},
    {HXA_FLASH_PART_BOOTOVL,  256 * KiB,      false},
};
// clang-format on

} // namespace

Flash_Partition* Flash::find(std::uint32_t type, std::uint32_t instance)
{
    auto found =
        std::find_if(partitions.begin(), partitions.end(),
                     [=](const Flash_Partition& partition) { return partition.type == type && partition.instance == instance; });
    return found == partitions.end() ? nullptr : &*found;
}

Flash usual_flash(std::size_t ports)
{
    Flash flash;
    for (const auto& row : usual_partitions)
        for (std::uint32_t instance = 0; instance < (row.per_port ? ports : 1); ++instance)
            flash.partitions.push_back({.type = row.type, .instance = instance, .size = row.size});
    flash.partitions.front().status = HXA_FLASH_STATUS_GOOD;
    return flash;
}

bool write(Flash_Partition& partition, std::span<const std::uint8_t> bytes)
{
    if (bytes.size() > partition.size)
        return false;
    if (partition.status == HXA_FLASH_STATUS_BAD)
        return true;
    partition.data.assign(bytes.begin(), bytes.end());
    partition.status = HXA_FLASH_STATUS_GOOD;
    return true;
}

void erase(Flash_Partition& partition)
{
    partition.data.clear();
    if (partition.status != HXA_FLASH_STATUS_BAD)
        partition.status = HXA_FLASH_STATUS_EMPTY;
}

bool read(const Flash_Partition& partition, std::span<std::uint8_t> bytes)
{
    if (bytes.size() > partition.size)
        return false;
    auto kept = std::min(bytes.size(), partition.data.size());
    std::copy_n(partition.data.begin(), kept, bytes.begin());
    std::fill(bytes.begin() + static_cast<std::ptrdiff_t>(kept), bytes.end(), erased);
    return true;
}

} // namespace hxasim
