#include "sim/command_table.h"

#include <algorithm>
#include <cstring>
#include <type_traits>

namespace hxasim
{

namespace
{

constexpr const hxal::Command* catalogued(std::string_view name)
{
    for (const auto& command : hxal::catalogue)
        if (command.name == name)
            return &command;
    throw "no such command in the catalogue";
}

template <auto> struct Answer_Record;
template <typename Record, void (*function)(Call&, Record&)> struct Answer_Record<function>
{
    using type = Record;
};

template <typename Record> consteval std::optional<std::size_t> status_offset()
{
    if constexpr (requires(Record record) { record.status; })
        return offsetof(Record, status);
    else
        return std::nullopt;
}

template <auto function> void answer_with(Call& call, std::span<std::uint8_t> bytes)
{
    typename Answer_Record<function>::type record;
    static_assert(std::is_trivially_copyable_v<decltype(record)> && sizeof(record) <= max_record_size);
    std::memcpy(&record, bytes.data(), sizeof(record));
    function(call, record);
    std::memcpy(bytes.data(), &record, sizeof(record));
}

template <auto function> consteval Row row(std::string_view name, Target target, std::array<Field, 4> inputs = {})
{
    using Record = typename Answer_Record<function>::type;
    const auto* command = catalogued(name);
    if (command->record != &hxal::record_tag<Record>)
        throw "the catalogue has another record for this command";
    return {.command = command,
            .target = target,
            .status = status_offset<Record>(),
            .inputs = inputs,
            .answer = answer_with<function>};
}

constexpr std::array<Field, 4> input(std::size_t offset, std::size_t size) { return {Field{.offset = offset, .size = size}}; }

constexpr auto application = input(offsetof(hxa_ioctl_aen_t, app_id), 4);
constexpr auto power = input(offsetof(hxa_ioctl_ioc_power_t, power), 4);
constexpr auto name = input(offsetof(hxa_ioctl_ioc_set_adapter_name_t, name), 64);
constexpr auto interrupts = input(offsetof(hxa_ioctl_iocfc_intr_t, attr), sizeof(hxa_iocfc_intr_attr_t));
constexpr auto manufacturing = input(offsetof(hxa_ioctl_flash_mfg_t, mfg_block), sizeof(hxa_mfg_block_t));

// clang-format off
constexpr std::array<Field, 4> partition{
    Field{.offset = offsetof(hxa_ioctl_flash_t, instance), .size = 1},
    Field{.offset = offsetof(hxa_ioctl_flash_t, type),     .size = 4},
};
constexpr std::array<Field, 4> partition_data{
    partition[0],
    partition[1],
    Field{.offset = offsetof(hxa_ioctl_flash_t, buf_ptr), .size = 8},
    Field{.offset = offsetof(hxa_ioctl_flash_t, bufsz),   .size = 4},
};

constexpr std::array rows{
    row<answer_version>                ("IOCMD_IOC_GET_VERSION",      Target::driver),
    row<answer_instances>              ("IOCMD_IOC_GET_INST",         Target::driver),
    row<answer_ioc_enable>             ("IOCMD_IOC_ENABLE",           Target::ioc),
    row<answer_ioc_disable>            ("IOCMD_IOC_DISABLE",          Target::ioc),
    row<answer_ioc_attributes>         ("IOCMD_IOC_GET_ATTR",         Target::ioc),
    row<answer_ioc_info>               ("IOCMD_IOC_GET_INFO",         Target::ioc),
    row<answer_ioc_statistics>         ("IOCMD_IOC_GET_STATS",        Target::ioc),
    row<answer_ioc_reset_statistics>   ("IOCMD_IOC_RESET_STATS",      Target::ioc),
    row<answer_ioc_power>              ("IOCMD_IOC_SET_POWER",        Target::ioc,    power),
    row<answer_adapter_name>           ("IOCMD_IOC_SET_ADAPTER_NAME", Target::ioc,    name),
    row<answer_port_name>              ("IOCMD_IOC_SET_PORT_NAME",    Target::ioc,    name),
    row<answer_event_sync>             ("IOCMD_AEN_SYNC",             Target::driver, application),
    row<answer_port_attributes>        ("IOCMD_PORT_GET_ATTR",        Target::ioc),
    row<answer_iocfc_attributes>       ("IOCMD_IOCFC_GET_ATTR",       Target::ioc),
    row<answer_iocfc_statistics>       ("IOCMD_IOCFC_GET_STATS",      Target::ioc),
    row<answer_iocfc_reset_statistics> ("IOCMD_IOCFC_RESET_STATS",    Target::ioc),
    row<answer_iocfc_interrupts>       ("IOCMD_IOCFC_SET_INTR",       Target::ioc,    interrupts),
    row<answer_flash_attributes>       ("IOCMD_FLASH_GET_ATTR",       Target::ioc),
    row<answer_flash_erase>            ("IOCMD_FLASH_ERASE_PART",     Target::ioc,    partition),
    row<answer_flash_update>           ("IOCMD_FLASH_UPDATE_PART",    Target::ioc,    partition_data),
    row<answer_flash_read>             ("IOCMD_FLASH_READ_PART",      Target::ioc,    partition_data),
    row<answer_flash_manufacturing>    ("IOCMD_FLASH_MFG_INFO",       Target::ioc,    manufacturing),
    row<answer_optrom_enable>          ("IOCMD_FLASH_ENABLE_OPTROM",  Target::ioc),
    row<answer_optrom_disable>         ("IOCMD_FLASH_DISABLE_OPTROM", Target::ioc),
};
// clang-format on

} // namespace

const Row* row_of(const hxal::Command& command)
{
    auto found = std::find_if(rows.begin(), rows.end(), [&](const Row& row) { return row.command == &command; });
    return found == rows.end() ? nullptr : &*found;
}

const Row* row_named(std::string_view wanted)
{
    auto found = std::find_if(rows.begin(), rows.end(), [&](const Row& row) { return row.command->name == wanted; });
    return found == rows.end() ? nullptr : &*found;
}

} // namespace hxasim
