// The command catalogue: every request the drivers know, one row each (C++ only; the library and the simulator read it).
//
// A command number is the Linux read/write request code: direction 3 in bits 31..30, record size in bits 29..16, group
// byte in bits 15..8, number within the group in bits 7..0.
#pragma once

#include "hxal/records/aen.h"
#include "hxal/records/diag.h"
#include "hxal/records/ethport.h"
#include "hxal/records/fcoe.h"
#include "hxal/records/fcpt.h"
#include "hxal/records/flash.h"
#include "hxal/records/ioc.h"
#include "hxal/records/iocfc.h"
#include "hxal/records/itnim.h"
#include "hxal/records/lport.h"
#include "hxal/records/port.h"
#include "hxal/records/port_config.h"
#include "hxal/records/port_stats.h"
#include "hxal/records/rport.h"
#include "hxal/records/scsi.h"
#include "hxal/records/sfp.h"

#include <array>
#include <cstdint>
#include <string_view>

namespace hxal
{

// The group byte of a command family, by the type of the IOC it is sent to.
struct Family
{
    std::uint8_t fc; // FC and FCoE IOCs
    std::uint8_t ll; // Ethernet IOCs
};

inline constexpr Family common_family{.fc = 'C', .ll = 'D'};
inline constexpr Family event_family{.fc = 'C', .ll = 'C'};
inline constexpr Family iocfc_family{.fc = 0xB0, .ll = 'D'};
inline constexpr Family lport_family{.fc = 0xB1, .ll = 0xB1};
inline constexpr Family rport_family{.fc = 0xB2, .ll = 0xB2};
inline constexpr Family flash_family{.fc = 0xB5, .ll = 0xB5};
inline constexpr Family passthrough_family{.fc = 0xBA, .ll = 0xBA};
inline constexpr Family itnim_family{.fc = 0xBB, .ll = 0xBB};
inline constexpr Family fcoe_family{.fc = 0xC1, .ll = 'D'};

// Its address stands for the record type in a row of the catalogue.
template <typename Record> inline constexpr char record_tag = 0;

struct Command
{
    std::string_view name;
    Family family;
    std::uint8_t number;
    std::uint32_t size; // of the record, in bytes, as the command number tells it
    const char* record; // tag of the record type
};

template <typename Record> consteval Command command(std::string_view name, Family family, std::uint8_t number)
{
    return {.name = name, .family = family, .number = number, .size = sizeof(Record), .record = &record_tag<Record>};
}

// A command whose number tells another size than its record has.
template <typename Record>
consteval Command command(std::string_view name, Family family, std::uint8_t number, std::uint32_t size)
{
    return {.name = name, .family = family, .number = number, .size = size, .record = &record_tag<Record>};
}

// clang-format off
inline constexpr std::array catalogue{
    //      record                            name                          family              no., size in the command number
    command<hxa_ioctl_ioc_get_version_t>(     "IOCMD_IOC_GET_VERSION",      common_family,      0x01),
    command<hxa_ioctl_ioc_get_inst_t>(        "IOCMD_IOC_GET_INST",         common_family,      0x02),
    command<hxa_ioctl_gen_t>(                 "IOCMD_IOC_ENABLE",           common_family,      0x03),
    command<hxa_ioctl_gen_t>(                 "IOCMD_IOC_DISABLE",          common_family,      0x04),
    command<hxa_ioctl_ioc_attr_t>(            "IOCMD_IOC_GET_ATTR",         common_family,      0x06),
    command<hxa_ioctl_ioc_info_t>(            "IOCMD_IOC_GET_INFO",         common_family,      0x07),
    command<hxa_ioctl_ioc_stats_t>(           "IOCMD_IOC_GET_STATS",        common_family,      0x08),
    command<hxa_ioctl_gen_t>(                 "IOCMD_IOC_RESET_STATS",      common_family,      0x09),
    command<hxa_ioctl_ioc_power_t>(           "IOCMD_IOC_SET_POWER",        common_family,      0x0A),
    command<hxa_ioctl_ioc_set_adapter_name_t>("IOCMD_IOC_SET_ADAPTER_NAME", common_family,      0x0C),
    command<hxa_ioctl_ioc_set_adapter_name_t>("IOCMD_IOC_SET_PORT_NAME",    common_family,      0x0D),
    command<hxa_ioctl_diag_regread_t>(        "IOCMD_DIAG_REGREAD",         common_family,      0x0E),
    command<hxa_ioctl_diag_regwrite_t>(       "IOCMD_DIAG_REGWRITE",        common_family,      0x10),
    command<hxa_ioctl_diag_get_temp_t>(       "IOCMD_DIAG_TEMP",            common_family,      0x11),
    command<hxa_ioctl_diag_memtest_t>(        "IOCMD_DIAG_MEMTEST",         common_family,      0x13),
    command<hxa_ioctl_diag_loopback_t>(       "IOCMD_DIAG_LOOPBACK",        common_family,      0x14),
    command<hxa_ioctl_diag_fwping_t>(         "IOCMD_DIAG_FWPING",          common_family,      0x15),
    command<hxa_ioctl_diag_qtest_t>(          "IOCMD_DIAG_QUEUETEST",       common_family,      0x16),
    command<hxa_ioctl_sfp_show_t>(            "IOCMD_DIAG_SFP",             common_family,      0x18),
    command<hxa_ioctl_diag_led_t>(            "IOCMD_DIAG_LED",             common_family,      0x19),
    command<hxa_ioctl_diag_beacon_t>(         "IOCMD_DIAG_BEACON",          common_family,      0x1A),
    command<hxa_ioctl_diag_ll_loopback_t>(    "IOCMD_DIAG_LL_LOOPBACK",     common_family,      0x1B),
    command<hxa_ioctl_diag_lb_stat_t>(        "IOCMD_DIAG_LB_STAT",         common_family,      0x1C),
    command<hxal_ioctl_aen_t>(                "IOCMD_AEN_GET",              event_family,       0x29, 88),
    command<hxa_ioctl_aen_t>(                 "IOCMD_AEN_SYNC",             common_family,      0x2A),
    command<hxa_ioctl_gen_t>(                 "IOCMD_PORT_ENABLE",          common_family,      0x2B),
    command<hxa_ioctl_gen_t>(                 "IOCMD_PORT_DISABLE",         common_family,      0x2C),
    command<hxa_ioctl_port_attr_t>(           "IOCMD_PORT_GET_ATTR",        common_family,      0x2D),
    command<hxa_ioctl_port_stats_t>(          "IOCMD_PORT_GET_STATS",       common_family,      0x2E),
    command<hxa_ioctl_gen_t>(                 "IOCMD_PORT_RESET_STATS",     common_family,      0x31),
    command<hxa_ioctl_port_cfg_topo_t>(       "IOCMD_PORT_CFG_TOPO",        common_family,      0x32),
    command<hxa_ioctl_port_cfg_speed_t>(      "IOCMD_PORT_CFG_SPEED",       common_family,      0x33),
    command<hxa_ioctl_port_alpa_t>(           "IOCMD_PORT_CFG_ALPA",        common_family,      0x34),
    command<hxa_ioctl_port_alpa_t>(           "IOCMD_PORT_CLR_ALPA",        common_family,      0x35),
    command<hxa_ioctl_port_cfg_maxfrsize_t>(  "IOCMD_PORT_CFG_MAXFRSZ",     common_family,      0x36),
    command<hxa_ioctl_port_trunk_t>(          "IOCMD_PORT_TRUNK_ENABLE",    common_family,      0x37),
    command<hxa_ioctl_port_trunk_t>(          "IOCMD_PORT_TRUNK_DISABLE",   common_family,      0x38),
    command<hxa_ioctl_port_rnid_t>(           "IOCMD_PORT_CFG_RNID",        common_family,      0x39),
    command<hxa_ioctl_port_rnid_t>(           "IOCMD_PORT_GET_RNID",        common_family,      0x3A),
    command<hxa_ioctl_sfp_media_t>(           "IOCMD_SFP_MEDIA",            common_family,      0x3F),
    command<hxa_ioctl_sfp_speed_t>(           "IOCMD_SFP_SPEED",            common_family,      0x40),
    command<hxa_ioctl_ethport_stats_t>(       "IOCMD_ETHPORT_GET_STATS",    common_family,      0x42),
    command<hxa_ioctl_ethport_attr_t>(        "IOCMD_ETHPORT_GET_ATTR",     common_family,      0x43),
    command<hxa_ioctl_iocfc_attr_t>(          "IOCMD_IOCFC_GET_ATTR",       iocfc_family,       0x01),
    command<hxa_ioctl_iocfc_stats_t>(         "IOCMD_IOCFC_GET_STATS",      iocfc_family,       0x02),
    command<hxa_ioctl_gen_t>(                 "IOCMD_IOCFC_RESET_STATS",    iocfc_family,       0x03),
    command<hxa_ioctl_iocfc_intr_t>(          "IOCMD_IOCFC_SET_INTR",       iocfc_family,       0x04),
    command<hxa_ioctl_lport_attr_t>(          "IOCMD_LPORT_GET_ATTR",       lport_family,       0x01),
    command<hxa_ioctl_lport_stats_t>(         "IOCMD_LPORT_GET_STATS",      lport_family,       0x02),
    command<hxa_ioctl_lport_reset_stats_t>(   "IOCMD_LPORT_RESET_STATS",    lport_family,       0x03),
    command<hxa_ioctl_lport_get_rports_t>(    "IOCMD_LPORT_GET_RPORTS",     lport_family,       0x04),
    command<hxa_ioctl_rport_t>(               "IOCMD_RPORT_ADD",            rport_family,       0x01),
    command<hxa_ioctl_rport_t>(               "IOCMD_RPORT_REMOVE",         rport_family,       0x02),
    command<hxa_ioctl_rport_stats_t>(         "IOCMD_RPORT_GET_STATS",      rport_family,       0x03),
    command<hxa_ioctl_rport_reset_stats_t>(   "IOCMD_RPORT_RESET_STATS",    rport_family,       0x04),
    command<hxa_ioctl_rport_attr_t>(          "IOCMD_RPORT_GET_ATTR",       rport_family,       0x05),
    command<hxa_ioctl_rport_scsi_addr_t>(     "IOCMD_RPORT_GET_SCSI_ADDR",  rport_family,       0x06),
    command<hxa_ioctl_rport_set_speed_t>(     "IOCMD_RPORT_SET_SPEED",      rport_family,       0x07),
    command<hxa_ioctl_flash_attr_t>(          "IOCMD_FLASH_GET_ATTR",       flash_family,       0x01),
    command<hxa_ioctl_flash_t>(               "IOCMD_FLASH_ERASE_PART",     flash_family,       0x02),
    command<hxa_ioctl_flash_t>(               "IOCMD_FLASH_UPDATE_PART",    flash_family,       0x03),
    command<hxa_ioctl_flash_t>(               "IOCMD_FLASH_READ_PART",      flash_family,       0x04),
    command<hxa_ioctl_flash_mfg_t>(           "IOCMD_FLASH_MFG_INFO",       flash_family,       0x05),
    command<hxa_ioctl_gen_t>(                 "IOCMD_FLASH_ENABLE_OPTROM",  flash_family,       0x06),
    command<hxa_ioctl_gen_t>(                 "IOCMD_FLASH_DISABLE_OPTROM", flash_family,       0x07),
    command<hxa_ioctl_scsi_t>(                "IOCMD_SCSI_CMND",            passthrough_family, 0x01),
    command<hxa_ioctl_fcpt_t>(                "IOCMD_FCPT",                 passthrough_family, 0x02),
    command<hxa_ioctl_itnim_attr_t>(          "IOCMD_ITNIM_GET_ATTR",       itnim_family,       0x01),
    command<hxa_ioctl_itnim_stats_t>(         "IOCMD_ITNIM_GET_STATS",      itnim_family,       0x02),
    command<hxa_ioctl_itnim_reset_stats_t>(   "IOCMD_ITNIM_RESET_STATS",    itnim_family,       0x03),
    command<hxa_ioctl_fcport_stats_t>(        "IOCMD_FCOE_GET_STATS",       fcoe_family,        0x01),
    command<hxa_ioctl_gen_t>(                 "IOCMD_FCOE_RESET_STATS",     fcoe_family,        0x02),
};
// clang-format on

// The command number under a group byte.
constexpr std::uint32_t command_code(const Command& command, std::uint8_t group)
{
    return std::uint32_t{3} << 30 | command.size << 16 | std::uint32_t{group} << 8 | command.number;
}

consteval bool has_codes(std::string_view name, std::uint32_t fc, std::uint32_t ll)
{
    for (const Command& each : catalogue)
        if (each.name == name)
            return command_code(each, each.family.fc) == fc && command_code(each, each.family.ll) == ll;
    return false;
}

// The commands that operations compose: what their requests are, each by itself. The number of the fetch tells another size than
// its record has, and its group does not follow the IOC's type.
static_assert(has_codes("IOCMD_IOC_GET_VERSION", 0xC0084301, 0xC0084401));
static_assert(has_codes("IOCMD_IOC_GET_INST", 0xC0284302, 0xC0284402));
static_assert(has_codes("IOCMD_IOC_ENABLE", 0xC0084303, 0xC0084403));
static_assert(has_codes("IOCMD_IOC_DISABLE", 0xC0084304, 0xC0084404));
static_assert(has_codes("IOCMD_IOC_SET_ADAPTER_NAME", 0xC048430C, 0xC048440C));
static_assert(has_codes("IOCMD_AEN_GET", 0xC0584329, 0xC0584329));
static_assert(has_codes("IOCMD_AEN_SYNC", 0xC058432A, 0xC058442A));
static_assert(has_codes("IOCMD_PORT_GET_STATS", 0xC018432E, 0xC018442E));
static_assert(has_codes("IOCMD_LPORT_GET_STATS", 0xC0C0B102, 0xC0C0B102));
static_assert(has_codes("IOCMD_FLASH_UPDATE_PART", 0xC018B503, 0xC018B503));
static_assert(has_codes("IOCMD_FLASH_READ_PART", 0xC018B504, 0xC018B504));
static_assert(has_codes("IOCMD_ITNIM_GET_ATTR", 0xC038BB01, 0xC038BB01));
static_assert(has_codes("IOCMD_FCOE_GET_STATS", 0xC170C101, 0xC1704401));

// On the FC node every code stands for one command. On the Ethernet node two commands share one, which the library tells apart
// before it sends.
consteval bool codes_differ()
{
    for (const Command& one : catalogue)
        for (const Command& other : catalogue)
            if (&one != &other &&
                (one.name == other.name || command_code(one, one.family.fc) == command_code(other, other.family.fc)))
                return false;
    return true;
}
static_assert(catalogue.size() == 72 && codes_differ());

} // namespace hxal
