// Requests to the flash of the card behind an I/O controller.
#include "sim/commands/caller_memory.h"
#include "sim/commands/row.h"
#include "sim/model/flash.h"

#include <cerrno>

namespace hxasim
{

namespace
{

// The partition that a request names. Without one the record has its status.
Flash_Partition* partition_of(const Call& call, hxa_ioctl_flash_t& record)
{
    auto* partition = call.ioc->adapter->flash.find(record.type, record.instance);
    if (partition && partition->status != HXA_FLASH_STATUS_NOT_PRESENT)
        return partition;
    record.status = HXA_STATUS_EINVAL;
    return nullptr;
}

// The same, which has to hold as many bytes as the sender's buffer.
Flash_Partition* partition_for_buffer(const Call& call, hxa_ioctl_flash_t& record)
{
    auto* partition = partition_of(call, record);
    if (!partition || (record.bufsz > 0 && static_cast<std::uint32_t>(record.bufsz) <= partition->size))
        return partition;
    record.status = HXA_STATUS_FLASH_BAD_LEN;
    return nullptr;
}

void answer_flash_attributes(Call& call, hxa_ioctl_flash_attr_t& record)
{
    const auto& partitions = call.ioc->adapter->flash.partitions;
    record.attr.npart = static_cast<std::uint32_t>(partitions.size());
    std::uint32_t offset = 0;
    auto* field = record.attr.part;
    for (const auto& partition : partitions)
    {
        field->part_type = partition.type;
        field->part_instance = partition.instance;
        field->part_off = offset;
        field->part_size = partition.size;
        field->part_len = static_cast<std::uint32_t>(partition.data.size());
        field->part_status = partition.status;
        offset += partition.size;
        ++field;
    }
}

void answer_erase(Call& call, hxa_ioctl_flash_t& record)
{
    if (auto* partition = partition_of(call, record))
        erase(*partition);
}

void answer_update(Call& call, hxa_ioctl_flash_t& record)
{
    auto* partition = partition_for_buffer(call, record);
    if (!partition)
        return;
    std::vector<std::uint8_t> bytes(static_cast<std::size_t>(record.bufsz));
    if (!copy_from_caller(bytes, address_of(record.buf_ptr)))
        return call.refuse(EFAULT, "bad buffer address");
    write(*partition, bytes);
}

void answer_read(Call& call, hxa_ioctl_flash_t& record)
{
    const auto* partition = partition_for_buffer(call, record);
    if (!partition)
        return;
    std::vector<std::uint8_t> bytes(static_cast<std::size_t>(record.bufsz));
    read(*partition, bytes);
    if (!copy_to_caller(address_of(record.buf_ptr), bytes))
        call.refuse(EFAULT, "bad buffer address");
}

// The manufacturing block is what the partition of that name holds.
void answer_manufacturing(Call& call, hxa_ioctl_flash_mfg_t& record)
{
    const auto* bytes = reinterpret_cast<const std::uint8_t*>(&record.mfg_block);
    auto* partition = call.ioc->adapter->flash.find(HXA_FLASH_PART_MFG, 0);
    if (!partition || !write(*partition, {bytes, sizeof(record.mfg_block)}))
        record.status = HXA_STATUS_NOFLASH;
}

void answer_optrom_enable(Call& call, hxa_ioctl_gen_t&) { call.ioc->adapter->flash.optrom_enabled = true; }
void answer_optrom_disable(Call& call, hxa_ioctl_gen_t&) { call.ioc->adapter->flash.optrom_enabled = false; }

constexpr auto partition = [](auto& record) { return std::tie(record.instance, record.type); };
constexpr auto partition_data = [](auto& record) { return std::tie(record.instance, record.type, record.buf_ptr, record.bufsz); };
constexpr auto block = [](auto& record) { return std::tie(record.mfg_block); };
constexpr auto flash_buffers = [](const auto& record) {
    return std::vector{Buffer{record.buf_ptr, record.bufsz > 0 ? static_cast<std::uint32_t>(record.bufsz) : 0}};
};

// clang-format off
constexpr Row flash_table[] = {
    ioc_row<answer_flash_attributes>("IOCMD_FLASH_GET_ATTR"),
    ioc_row<answer_erase>(           "IOCMD_FLASH_ERASE_PART",     partition),
    ioc_row<answer_update>(          "IOCMD_FLASH_UPDATE_PART",    partition_data),
    ioc_row<answer_read>(            "IOCMD_FLASH_READ_PART",      partition_data, flash_buffers),
    ioc_row<answer_manufacturing>(   "IOCMD_FLASH_MFG_INFO",       block),
    ioc_row<answer_optrom_enable>(   "IOCMD_FLASH_ENABLE_OPTROM"),
    ioc_row<answer_optrom_disable>(  "IOCMD_FLASH_DISABLE_OPTROM"),
};
// clang-format on

} // namespace

std::span<const Row> flash_rows() { return flash_table; }

} // namespace hxasim
