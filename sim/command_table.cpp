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

template <auto function> void answer_with(Call& call, std::vector<std::uint8_t>& bytes)
{
    typename Answer_Record<function>::type record{};
    static_assert(std::is_trivially_copyable_v<decltype(record)> && sizeof(record) <= max_record_size);
    std::memcpy(&record, bytes.data(), bytes.size());
    function(call, record);
    bytes.resize(call.answer_size.value_or(sizeof(record)));
    std::memcpy(bytes.data(), &record, bytes.size());
}

// The record of an event fetch is as long as the sender has room, whatever the command's number tells: only its head is
// sure to be there, and only as much comes back as there are events. What an IOC raised can be fetched after it has gone.
constexpr bool is_event_fetch(const hxal::Command& command) { return command.name == "IOCMD_AEN_GET"; }

template <typename Record> consteval Field instance_field()
{
    if constexpr (requires(Record record) { record.hxad_num; })
        return {.offset = offsetof(Record, hxad_num), .size = sizeof(Record::hxad_num)};
    else
        return {};
}

template <auto function> consteval Row row(std::string_view name, Target target, std::array<Field, 4> inputs = {})
{
    using Record = typename Answer_Record<function>::type;
    const auto* command = catalogued(name);
    if (command->record != &hxal::record_tag<Record>)
        throw "the catalogue has another record for this command";
    if (target == Target::ioc && instance_field<Record>().size == 0)
        throw "the record carries no instance";
    return {.command = command,
            .target = target,
            .record_size = sizeof(Record),
            .sent_size = is_event_fetch(*command) ? offsetof(hxal_ioctl_aen_t, aen_list) : sizeof(Record),
            .instance = instance_field<Record>(),
            .status = status_offset<Record>(),
            .inputs = inputs,
            .answer = answer_with<function>,
            .of_absent = is_event_fetch(*command)};
}

constexpr std::array<Field, 4> input(std::size_t offset, std::size_t size) { return {Field{.offset = offset, .size = size}}; }

constexpr auto application = input(offsetof(hxa_ioctl_aen_t, app_id), 4);
constexpr auto event_room = input(offsetof(hxal_ioctl_aen_t, aen_count), 4 + 4); // and the application
constexpr auto power = input(offsetof(hxa_ioctl_ioc_power_t, power), 4);
constexpr auto name = input(offsetof(hxa_ioctl_ioc_set_adapter_name_t, name), 64);
constexpr auto interrupts = input(offsetof(hxa_ioctl_iocfc_intr_t, attr), sizeof(hxa_iocfc_intr_attr_t));
constexpr auto manufacturing = input(offsetof(hxa_ioctl_flash_mfg_t, mfg_block), sizeof(hxa_mfg_block_t));

constexpr std::array<Field, 4> registers{Field{.offset = offsetof(hxa_ioctl_diag_regread_t, off), .size = 4 + 4},
                                         Field{.offset = offsetof(hxa_ioctl_diag_regread_t, buf_ptr), .size = 8}};
constexpr auto register_word = input(offsetof(hxa_ioctl_diag_regwrite_t, off), 4 + 4);
constexpr std::array<Field, 4> memory_test{Field{.offset = offsetof(hxa_ioctl_diag_memtest_t, pat), .size = 4},
                                           Field{.offset = offsetof(hxa_ioctl_diag_memtest_t, memtest.algo), .size = 1}};
constexpr auto loopback = input(offsetof(hxa_ioctl_diag_loopback_t, opmode), 4 + 4 + 4 + 4);
constexpr auto ethernet_loopback = input(offsetof(hxa_ioctl_diag_ll_loopback_t, opmode), 4 + 4 + 4);
constexpr auto firmware_ping = input(offsetof(hxa_ioctl_diag_fwping_t, cnt), 4 + 4);
constexpr auto queue_test = input(offsetof(hxa_ioctl_diag_qtest_t, queue), 4);
constexpr auto led_test = input(offsetof(hxa_ioctl_diag_led_t, ledtest), sizeof(hxa_diag_ledtest_t));
constexpr auto beacon = input(offsetof(hxa_ioctl_diag_beacon_t, beacon), 4 + 4 + 4);
constexpr auto sfp_speed = input(offsetof(hxa_ioctl_sfp_speed_t, speed), 4);

constexpr auto topology = input(offsetof(hxa_ioctl_port_cfg_topo_t, topo), 4);
constexpr auto speed = input(offsetof(hxa_ioctl_port_cfg_speed_t, speed), 4);
constexpr auto address = input(offsetof(hxa_ioctl_port_alpa_t, alpa), 1);
constexpr auto frame_size = input(offsetof(hxa_ioctl_port_cfg_maxfrsize_t, maxfrsize), 2);
constexpr auto trunk = input(offsetof(hxa_ioctl_port_trunk_t, pp_bmap), 1);
constexpr auto identity = input(offsetof(hxa_ioctl_port_rnid_t, info), sizeof(hxa_pport_rnid_t));
constexpr std::array<Field, 4> buffer{Field{.offset = offsetof(hxa_ioctl_port_stats_t, buf_size), .size = 4},
                                      Field{.offset = offsetof(hxa_ioctl_port_stats_t, buf_ptr), .size = 8}};

// The virtual fabric and one WWN or two, which stand side by side, and what follows them.
constexpr auto lport = input(offsetof(hxa_ioctl_lport_attr_t, vf_id), 2 + 8);
constexpr auto rport = input(offsetof(hxa_ioctl_rport_t, vf_id), 2 + 8 + 8);
constexpr auto rport_list = input(offsetof(hxa_ioctl_lport_get_rports_t, vf_id), 2 + 8 + 8 + 4);
constexpr std::array<Field, 4> rport_speed{Field{.offset = offsetof(hxa_ioctl_rport_set_speed_t, vf_id), .size = 2 + 4},
                                           Field{.offset = offsetof(hxa_ioctl_rport_set_speed_t, pwwn), .size = 8 + 8}};
constexpr std::array<Field, 4> frame{Field{.offset = offsetof(hxa_ioctl_fcpt_t, vf_id), .size = 2 + 8 + 8 + 4 + 4 + 4},
                                     Field{.offset = offsetof(hxa_ioctl_fcpt_t, fchs), .size = sizeof(fchs_t) + 4 + 4 + 4},
                                     Field{.offset = offsetof(hxa_ioctl_fcpt_t, reqbuf_ptr), .size = 8 + 8}};
constexpr std::array<Field, 4> scsi{Field{.offset = offsetof(hxa_ioctl_scsi_t, vf_id), .size = 2 + 8 + 8 + 8 + 16 + 4 + 4},
                                    Field{.offset = offsetof(hxa_ioctl_scsi_t, snssz), .size = 4 + 8 + 8}};

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
    row<answer_version>               ("IOCMD_IOC_GET_VERSION",      Target::driver),
    row<answer_instances>             ("IOCMD_IOC_GET_INST",         Target::driver),
    row<answer_ioc_enable>            ("IOCMD_IOC_ENABLE",           Target::ioc),
    row<answer_ioc_disable>           ("IOCMD_IOC_DISABLE",          Target::ioc),
    row<answer_ioc_attributes>        ("IOCMD_IOC_GET_ATTR",         Target::ioc),
    row<answer_ioc_info>              ("IOCMD_IOC_GET_INFO",         Target::ioc),
    row<answer_ioc_statistics>        ("IOCMD_IOC_GET_STATS",        Target::ioc),
    row<answer_ioc_reset_statistics>  ("IOCMD_IOC_RESET_STATS",      Target::ioc),
    row<answer_ioc_power>             ("IOCMD_IOC_SET_POWER",        Target::ioc,    power),
    row<answer_adapter_name>          ("IOCMD_IOC_SET_ADAPTER_NAME", Target::ioc,    name),
    row<answer_port_name>             ("IOCMD_IOC_SET_PORT_NAME",    Target::ioc,    name),
    row<answer_register_read>         ("IOCMD_DIAG_REGREAD",         Target::ioc,    registers),
    row<answer_register_write>        ("IOCMD_DIAG_REGWRITE",        Target::ioc,    register_word),
    row<answer_temperature>           ("IOCMD_DIAG_TEMP",            Target::ioc),
    row<answer_memory_test>           ("IOCMD_DIAG_MEMTEST",         Target::ioc,    memory_test),
    row<answer_loopback>              ("IOCMD_DIAG_LOOPBACK",        Target::ioc,    loopback),
    row<answer_firmware_ping>         ("IOCMD_DIAG_FWPING",          Target::ioc,    firmware_ping),
    row<answer_queue_test>            ("IOCMD_DIAG_QUEUETEST",       Target::ioc,    queue_test),
    row<answer_sfp_memory>            ("IOCMD_DIAG_SFP",             Target::ioc),
    row<answer_led_test>              ("IOCMD_DIAG_LED",             Target::ioc,    led_test),
    row<answer_beacon>                ("IOCMD_DIAG_BEACON",          Target::ioc,    beacon),
    row<answer_ethernet_loopback>     ("IOCMD_DIAG_LL_LOOPBACK",     Target::ioc,    ethernet_loopback),
    row<answer_loopback_status>       ("IOCMD_DIAG_LB_STAT",         Target::ioc),
    row<answer_event_fetch>           ("IOCMD_AEN_GET",              Target::ioc,    event_room),
    row<answer_event_sync>            ("IOCMD_AEN_SYNC",             Target::driver, application),
    row<answer_port_enable>           ("IOCMD_PORT_ENABLE",          Target::ioc),
    row<answer_port_disable>          ("IOCMD_PORT_DISABLE",         Target::ioc),
    row<answer_port_attributes>       ("IOCMD_PORT_GET_ATTR",        Target::ioc),
    row<answer_port_statistics>       ("IOCMD_PORT_GET_STATS",       Target::ioc,    buffer),
    row<answer_port_reset_statistics> ("IOCMD_PORT_RESET_STATS",     Target::ioc),
    row<answer_port_topology>         ("IOCMD_PORT_CFG_TOPO",        Target::ioc,    topology),
    row<answer_port_speed>            ("IOCMD_PORT_CFG_SPEED",       Target::ioc,    speed),
    row<answer_port_hard_address>     ("IOCMD_PORT_CFG_ALPA",        Target::ioc,    address),
    row<answer_port_any_address>      ("IOCMD_PORT_CLR_ALPA",        Target::ioc),
    row<answer_port_frame_size>       ("IOCMD_PORT_CFG_MAXFRSZ",     Target::ioc,    frame_size),
    row<answer_port_trunk>            ("IOCMD_PORT_TRUNK_ENABLE",    Target::ioc,    trunk),
    row<answer_port_untrunk>          ("IOCMD_PORT_TRUNK_DISABLE",   Target::ioc),
    row<answer_port_identify>         ("IOCMD_PORT_CFG_RNID",        Target::ioc,    identity),
    row<answer_port_identification>   ("IOCMD_PORT_GET_RNID",        Target::ioc),
    row<answer_sfp_media>             ("IOCMD_SFP_MEDIA",            Target::ioc),
    row<answer_sfp_speed>             ("IOCMD_SFP_SPEED",            Target::ioc,    sfp_speed),
    row<answer_ethport_statistics>    ("IOCMD_ETHPORT_GET_STATS",    Target::ioc),
    row<answer_ethport_attributes>    ("IOCMD_ETHPORT_GET_ATTR",     Target::ioc),
    row<answer_iocfc_attributes>      ("IOCMD_IOCFC_GET_ATTR",       Target::ioc),
    row<answer_iocfc_statistics>      ("IOCMD_IOCFC_GET_STATS",      Target::ioc),
    row<answer_iocfc_reset_statistics>("IOCMD_IOCFC_RESET_STATS",    Target::ioc),
    row<answer_iocfc_interrupts>      ("IOCMD_IOCFC_SET_INTR",       Target::ioc,    interrupts),
    row<answer_lport_attributes>      ("IOCMD_LPORT_GET_ATTR",       Target::ioc,    lport),
    row<answer_lport_statistics>      ("IOCMD_LPORT_GET_STATS",      Target::ioc,    lport),
    row<answer_lport_reset_statistics>("IOCMD_LPORT_RESET_STATS",    Target::ioc,    lport),
    row<answer_lport_remote_ports>    ("IOCMD_LPORT_GET_RPORTS",     Target::ioc,    rport_list),
    row<answer_rport_add>             ("IOCMD_RPORT_ADD",            Target::ioc,    rport),
    row<answer_rport_remove>          ("IOCMD_RPORT_REMOVE",         Target::ioc,    rport),
    row<answer_rport_statistics>      ("IOCMD_RPORT_GET_STATS",      Target::ioc,    rport),
    row<answer_rport_reset_statistics>("IOCMD_RPORT_RESET_STATS",    Target::ioc,    rport),
    row<answer_rport_attributes>      ("IOCMD_RPORT_GET_ATTR",       Target::ioc,    rport),
    row<answer_rport_scsi_address>    ("IOCMD_RPORT_GET_SCSI_ADDR",  Target::ioc,    rport),
    row<answer_rport_speed>           ("IOCMD_RPORT_SET_SPEED",      Target::ioc,    rport_speed),
    row<answer_flash_attributes>      ("IOCMD_FLASH_GET_ATTR",       Target::ioc),
    row<answer_flash_erase>           ("IOCMD_FLASH_ERASE_PART",     Target::ioc,    partition),
    row<answer_flash_update>          ("IOCMD_FLASH_UPDATE_PART",    Target::ioc,    partition_data),
    row<answer_flash_read>            ("IOCMD_FLASH_READ_PART",      Target::ioc,    partition_data),
    row<answer_flash_manufacturing>   ("IOCMD_FLASH_MFG_INFO",       Target::ioc,    manufacturing),
    row<answer_optrom_enable>         ("IOCMD_FLASH_ENABLE_OPTROM",  Target::ioc),
    row<answer_optrom_disable>        ("IOCMD_FLASH_DISABLE_OPTROM", Target::ioc),
    row<answer_scsi_command>          ("IOCMD_SCSI_CMND",            Target::ioc,    scsi),
    row<answer_fc_pass_through>       ("IOCMD_FCPT",                 Target::ioc,    frame),
    row<answer_nexus_attributes>      ("IOCMD_ITNIM_GET_ATTR",       Target::ioc,    rport),
    row<answer_nexus_statistics>      ("IOCMD_ITNIM_GET_STATS",      Target::ioc,    rport),
    row<answer_nexus_reset_statistics>("IOCMD_ITNIM_RESET_STATS",    Target::ioc,    rport),
    row<answer_fcoe_statistics>       ("IOCMD_FCOE_GET_STATS",       Target::ioc),
    row<answer_fcoe_reset_statistics> ("IOCMD_FCOE_RESET_STATS",     Target::ioc),
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
