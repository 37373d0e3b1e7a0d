#include "operation_table.h"

#include <cstring>
#include <utility>

std::vector<std::uint8_t> bytes_of(const char* text) { return {text, text + std::strlen(text)}; }

namespace
{

using Op = Operation;

constexpr Groups common = {'C', 'D'};
constexpr Groups iocfc = {0xB0, 0};
constexpr Groups flash = {0xB5, 0xB5};
constexpr Groups lports = {0xB1, 0xB1};
constexpr Groups rports = {0xB2, 0xB2};
constexpr Groups nexuses = {0xBB, 0xBB};
constexpr Groups pass_through = {0xBA, 0xBA};

constexpr std::uint16_t vf = 0x0201;
constexpr wwn_t logical = 0x1716151413121110;
constexpr wwn_t remote = 0x2726252423222120;

// The virtual fabric, the logical port and the remote port as they stand in a record.
const Sent lport = {6, {0x01, 0x02, 0x10, 0x11, 0x12, 0x13, 0x14, 0x15, 0x16, 0x17}};
const Sent nexus = {6,
                    {0x01, 0x02, 0x10, 0x11, 0x12, 0x13, 0x14, 0x15, 0x16, 0x17, 0x20, 0x21, 0x22, 0x23, 0x24, 0x25, 0x26, 0x27}};

// Two numbers whose bytes all differ, and their places in a record.
constexpr std::uint32_t first = 0x01020304;
constexpr std::uint32_t second = 0x0A0B0C0D;
const std::vector<std::uint8_t> first_bytes = {4, 3, 2, 1};
const std::vector<std::uint8_t> second_bytes = {0x0D, 0x0C, 0x0B, 0x0A};
const std::vector<std::uint8_t> both_bytes = {4, 3, 2, 1, 0x0D, 0x0C, 0x0B, 0x0A};

// What requests refer to. A size that goes out is the one that stands in the harness's buffer before the call.
const std::vector<std::uint8_t> room = {0xEE, 0xEE, 0xEE, 0xEE};
std::uint32_t registers[4];
wwn_t wwns[4];
std::uint8_t request[3];
std::uint8_t response[16];

template <typename Pointer> std::vector<std::uint8_t> address_of(Pointer pointer)
{
    return bytes_of(static_cast<std::uint64_t>(reinterpret_cast<std::uintptr_t>(pointer)));
}

// Every byte of it differs.
template <typename Record> Record numbered()
{
    std::uint8_t bytes[sizeof(Record)];
    for (std::uint8_t at = 0; at < sizeof(Record); ++at)
        bytes[at] = static_cast<std::uint8_t>(0x40 + at);
    Record record;
    std::memcpy(&record, bytes, sizeof record);
    return record;
}

const auto lights = numbered<hxa_diag_ledtest_t>();
const auto identification = numbered<hxa_pport_rnid_t>();
const auto header = numbered<fchs_t>();

const std::string longest_name(64, 'n');
const std::string too_long_name = longest_name + "x";

// Interrupt moderation in the order of the record: on, latency 0x0201, delay 0x0403.
const std::vector<std::uint8_t> moderation = {1, 0, 0, 0, 1, 2, 3, 4};
const Lines moderation_lines = {"hxa1-delay = 1027;", "hxa1-latency = 513;"};

constexpr lun_t lun = 0x0000000000000540; // flat addressing, 5
constexpr std::uint32_t length = 0x0102032C;

// The harness's buffer gives the room for the sense data and takes their length, then the SCSI status.
template <typename Send> Op scsi(std::vector<std::uint8_t> cdb, std::vector<std::uint8_t> write, Send send)
{
    const auto call = [send](hxal_t* ioc, void* out)
    {
        auto* status = out ? static_cast<uint8_t*>(out) + 4 : nullptr;
        return send(ioc, status, static_cast<uint32_t*>(out));
    };
    return Op{pass_through, 0x01, 80, call}
        .sends({nexus,
                {24, bytes_of(lun)},
                {32, std::move(cdb)},
                {48, std::move(write)},
                {52, bytes_of(length)},
                {60, room},
                {64, address_of(request)},
                {72, address_of(response)}})
        .may_copy({{60, 4}, {59, 1, 4}});
}

const scsi_cdb_t any_command = {{1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12, 13, 14, 15, 16}};

hxa_status_t send_any_command(hxal_t* ioc, uint8_t* status, uint32_t* sense_size)
{
    return hxal_scsi_cmnd(ioc, vf, logical, remote, lun, &any_command, 1, request, length, status, response, sense_size);
}

// What a helper puts into a command that says 0xC0 in bytes 2, 9 and 15 so far.
Op scsi_helper(decltype(&hxal_scsi_inquiry) helper, std::vector<std::uint8_t> cdb)
{
    cdb.resize(16);
    cdb[2] = cdb[15] = 0xC0;
    if (cdb[9] == 0)
        cdb[9] = 0xC0;
    const auto send = [helper](hxal_t* ioc, uint8_t* status, uint32_t* sense_size)
    {
        scsi_cdb_t command = {{0, 0, 0xC0, 0, 0, 0, 0, 0, 0, 0xC0, 0, 0, 0, 0, 0, 0xC0}};
        return helper(ioc, vf, logical, remote, lun, &command, 1, request, length, status, response, sense_size);
    };
    return scsi(std::move(cdb), {}, send);
}

hxa_status_t get_scsi_address(hxal_t* ioc, uint32_t* numbers)
{
    return hxal_rport_get_scsi_address(ioc, vf, logical, remote, numbers, numbers ? numbers + 1 : nullptr,
                                       numbers ? numbers + 2 : nullptr);
}

} // namespace

const std::vector<Operation>& operations()
{
    // clang-format off
    static const std::vector<Operation> table = {
        Op{common, 0x07, 520,  read(hxal_ioc_get_info)}.copies({{0, 520}}).in_place(),
        Op{common, 0x06, 1608, read(hxal_ioc_get_attr)}.copies({{8, 1600}})
            .prints_on_error("IOCTL ERR  IOCMD_IOC_GET_ATTR   Interrupted system call\n"),
        Op{common, 0x08, 84,   read(hxal_ioc_get_stats)}.copies({{8, 76}}),
        Op{common, 0x09, 8,    call(hxal_ioc_reset_stats)},
        Op{common, 0x0A, 16,   call(hxal_ioc_set_power, HXA_PM_DS_D2)}.sends({{8, {2}}}),
        Op{common, 0x0D, 72,   call(hxal_ioc_set_name, "green")}.sends({{8, bytes_of("green")}})
            .records({"hxa1-port-name = \"green\";"}, {"hxn1-port-name = \"green\";"}),
        Op{common, 0x0D, 72,   call(hxal_ioc_set_name, too_long_name.c_str())}.sends({{8, bytes_of(longest_name.c_str())}})
            .records({"hxa1-port-name = \"" + too_long_name + "\";"}, {"hxn1-port-name = \"" + too_long_name + "\";"}),
        Op{{0xB0, 'D'}, 0x04, 16, call(hxal_ioc_intr_set, HXA_TRUE, 0x0403, 0x0201)}.sends({{8, moderation}})
            .records(moderation_lines),
        Op{iocfc, 0x04, 16,  call(hxal_iocfc_intr_set, HXA_TRUE, 0x0403, 0x0201)}.sends({{8, moderation}})
            .records(moderation_lines),
        Op{iocfc, 0x01, 64,  read(hxal_iocfc_get_attr)}.copies({{8, 56}}).prints_on_refusal("Not an FC IOC\n"),
        Op{iocfc, 0x02, 472, read(hxal_iocfc_get_stats)}.copies({{8, 464}}),
        Op{iocfc, 0x03, 8,   call(hxal_iocfc_reset_stats)},

        Op{common, 0x2D, 376, read(hxal_port_get_attr)}.copies({{8, 368}}),
        Op{common, 0x31, 8,   call(hxal_port_reset_stats)},
        Op{common, 0x32, 16,  call(hxal_port_cfg_topology, HXA_PPORT_TOPOLOGY_LOOP)}.sends({{8, {2}}})
            .records({"hxa1-port-topology = \"loop\";"}),
        Op{common, 0x33, 16,  call(hxal_port_cfg_speed, HXA_PPORT_SPEED_8GBPS)}.sends({{8, {8}}})
            .records({"hxa1-port-speed = 8;"}),
        Op{common, 0x34, 16,  call(hxal_port_cfg_hardalpa, 0xEF)}.sends({{8, {0xEF}}}).records({"hxa1-port-hardalpa = 0xef;"}),
        Op{common, 0x35, 16,  call(hxal_port_clr_hardalpa)},
        Op{common, 0x36, 8,   call(hxal_port_cfg_maxfrsize, 0x0804)}.sends({{6, {4, 8}}})
            .records({"hxa1-port-maxfrsize = 2052;"}),
        Op{common, 0x37, 8,   call(hxal_port_trunk_enable, 0x70503)}.sends({{6, {3}}})
            .records({"hxa1-port-trunk = 0, 1, 8, 10, 16, 17, 18;"}),
        Op{common, 0x38, 8,   call(hxal_port_trunk_disable)},
        Op{common, 0x39, 56,  call(hxal_port_cfg_rnid_info, identification)}.sends({{8, bytes_of(identification)}}),
        Op{common, 0x3A, 56,  read(hxal_port_get_rnid_info)}.copies({{8, 44}}),

        Op{common, 0x2B, 8,      call(hxal_fcoe_port_enable)},
        Op{common, 0x2C, 8,      call(hxal_fcoe_port_disable)}.records({"hxa1-port-enable = \"FALSE\";"}),
        Op{{0xC1, 'D'}, 0x02, 8, call(hxal_fcoe_reset_stats)},
        Op{common, 0x43, 24,     read(hxal_ethport_get_attr)}.copies({{8, 16}}),
        Op{common, 0x42, 288,    read(hxal_ethport_get_stats)}.copies({{8, 280}})
            .prints_on_error("IOCTL ERR  IOCMD_ETHPORT_GET_STATS   Interrupted system call\n"),
        Op{common, 0x31, 8,      call(hxal_ethport_reset_stats)},

        Op{lports, 0x01, 232, read(hxal_lport_get_attr, vf, logical)}.sends({lport}).copies({{16, 216}}),
        Op{lports, 0x03, 16,  call(hxal_lport_reset_stats, vf, logical)}.sends({lport}),
        Op{lports, 0x04, 32,  read(hxal_lport_get_rports, vf, logical, wwns)}
            .sends({lport, {16, address_of(wwns)}, {24, room}}).copies({{24, 4}}),

        Op{rports, 0x01, 24,  call(hxal_rport_add, vf, logical, remote)}.sends({nexus}),
        Op{rports, 0x02, 24,  call(hxal_rport_remove, vf, logical, remote)}.sends({nexus}),
        Op{rports, 0x03, 288, read(hxal_rport_get_stats, vf, logical, remote)}.sends({nexus}).copies({{24, 264}}),
        Op{rports, 0x04, 24,  call(hxal_rport_reset_stats, vf, logical, remote)}.sends({nexus}),
        Op{rports, 0x05, 344, read(hxal_rport_get_attr, vf, logical, remote)}.sends({nexus}).copies({{24, 320}}),
        Op{rports, 0x06, 40,  read(get_scsi_address)}.sends({nexus}).copies({{24, 12}}),
        Op{rports, 0x07, 32,  call(hxal_rport_set_speed, vf, logical, remote, HXA_PPORT_SPEED_4GBPS)}
            .sends({{6, {1, 2, 4}}, {16, bytes_of(logical)}, {24, bytes_of(remote)}}),

        Op{nexuses, 0x02, 168, read(hxal_itnim_get_stats, vf, logical, remote)}.sends({nexus}).copies({{24, 144}}),
        Op{nexuses, 0x03, 24,  call(hxal_itnim_reset_stats, vf, logical, remote)}.sends({nexus}),

        Op{pass_through, 0x02, 96, read(hxal_fcpt, vf, logical, remote, uint16_t{0x0A0B}, HXA_TRUE, FC_CLASS_2, &header, request,
                                        uint32_t{sizeof request}, response)}
            .sends({nexus, {24, {0x0B, 0x0A, 0, 0, 1, 0, 0, 0, 4}}, {40, bytes_of(header)}, {64, {1, 0, 0, 0, 3}}, {72, room},
                    {80, address_of(request)}, {88, address_of(response)}}).copies({{72, 4}}),
        Op{pass_through, 0x02, 96, read(hxal_fcpt, vf, logical, wwn_t{0}, uint16_t{0}, HXA_FALSE, FC_CLASS_3, &header, nullptr,
                                        uint32_t{0}, response)} // without destination and request
            .sends({lport, {32, {8}}, {40, bytes_of(header)}, {72, room}, {88, address_of(response)}}).copies({{72, 4}}),

        scsi(bytes_of(any_command), {1}, send_any_command),
        scsi_helper(hxal_scsi_inquiry,        {0x12, 0, 0, 0, 0x2C}),
        scsi_helper(hxal_scsi_readcapacity,   {0x25}),
        scsi_helper(hxal_scsi_readcapacity16, {0x9E, 0x10, 0, 0, 0, 0, 0, 0, 0, 0, 1, 2, 3, 0x2C}),
        scsi_helper(hxal_scsi_reportluns,     {0xA0, 0, 0, 0, 0, 0, 1, 2, 3, 0x2C}),
        scsi_helper(hxal_scsi_testunitready,  {0x00}),

        Op{common, 0x0E, 32,  call(hxal_diag_regread, first, 4, registers)}
            .sends({{8, {4, 3, 2, 1, 4}}, {24, address_of(registers)}}),
        Op{common, 0x10, 24,  call(hxal_diag_regwrite, first, second)}.sends({{8, both_bytes}}),
        Op{common, 0x11, 8,   read(hxal_diag_tsensor_query)}.may_copy({{6, 2}}),
        Op{common, 0x13, 56,  read(hxal_diag_memtest, second)}.sends({{12, second_bytes}}).may_copy({{16, 32}}),
        Op{common, 0x14, 48,  read(hxal_diag_loopback, HXA_PPORT_OPMODE_LB_CBL, HXA_PPORT_SPEED_4GBPS, uint32_t{1}, second)}
            .sends({{8, {8, 0, 0, 0, 4}}, {16, {0, 0, 0, 1, 0x0A, 0x0B, 0x0C, 0x0D}}}).may_copy({{24, 24}}),
        Op{common, 0x1B, 44,  read(hxal_diag_eth_loopback, HXA_PPORT_OPMODE_LB_EXT, uint32_t{1}, second)}
            .sends({{8, {4, 0, 0, 0, 1, 0, 0, 0}}, {16, second_bytes}}).may_copy({{20, 24}}),
        Op{common, 0x1C, 8,   call(hxal_diag_get_lb_status)},
        Op{common, 0x15, 56,  read(hxal_diag_fwping, first, second)}.sends({{8, both_bytes}}).may_copy({{16, 40}}),
        Op{common, 0x16, 24,  read(hxal_diag_queuetest, first)}.sends({{12, first_bytes}}).may_copy({{16, 8}}),
        Op{common, 0x18, 224, read(hxal_diag_sfp_query)}.may_copy({{8, 216}}),
        Op{common, 0x19, 24,  call(hxal_diag_led_test, &lights)}.sends({{8, bytes_of(lights)}}),
        Op{common, 0x1A, 20,  call(hxal_diag_beacon_swport, HXA_TRUE, first)}.sends({{8, {1, 0, 0, 0, 1, 0, 0, 0, 4, 3, 2, 1}}}),
        Op{common, 0x3F, 12,  read(hxal_sfp_media)}.may_copy({{8, 4}}),
        Op{common, 0x40, 12,  call(hxal_sfp_speed, first)}.sends({{8, first_bytes}}),

        Op{flash, 0x01, 528, read(hxal_flash_get_attr)}.copies({{8, 520}}),
        Op{flash, 0x02, 24,  call(hxal_flash_erase_part, HXA_FLASH_PART_FWCFG, 1)}.sends({{6, {1}}, {16, {3}}}),
        Op{flash, 0x05, 264, call(hxal_flash_mfg_info, "SERIAL-NUMBER", "PART-NUMBER-TOO-LONG", 0x0807060504030201,
                                  mac_t{{1, 2, 3, 4, 5, 6}}, 86)}
            .sends({{12, {0, 1}}, {16, bytes_of("SERIAL-NUMB")}, {28, bytes_of("PART-NUMBER-TO")}, {48, {1, 2, 3, 4, 5, 6, 7, 8}},
                    {128, {1, 2, 3, 4, 5, 6}}, {136, {86}}}),
        Op{flash, 0x06, 8,   call(hxal_flash_enable_optrom)},
        Op{flash, 0x07, 8,   call(hxal_flash_disable_optrom)},
    };
    // clang-format on
    return table;
}
