// The words that a scenario may write for the numbers of the drivers.
#pragma once

#include "sim/model/adapter.h"
#include "sim/scenario/json.h"

#include "hxal/records/ioc.h"
#include "hxal/records/itnim.h"
#include "hxal/records/port.h"
#include "hxal/records/rport.h"

#include <array>
#include <cerrno>

namespace hxasim
{

// clang-format off
inline constexpr std::array kind_words{
    Choice{"fc-hba",    static_cast<std::uint32_t>(Adapter_Kind::fc_hba)},
    Choice{"cna",       static_cast<std::uint32_t>(Adapter_Kind::cna)},
    Choice{"mezzanine", static_cast<std::uint32_t>(Adapter_Kind::mezzanine)},
};

inline constexpr std::array ioc_state_words{
    Choice{"reset",       HXA_IOC_RESET},
    Choice{"semwait",     HXA_IOC_SEMWAIT},
    Choice{"hwinit",      HXA_IOC_HWINIT},
    Choice{"getattr",     HXA_IOC_GETATTR},
    Choice{"operational", HXA_IOC_OPERATIONAL},
    Choice{"initfail",    HXA_IOC_INITFAIL},
    Choice{"hbfail",      HXA_IOC_HBFAIL},
    Choice{"disabling",   HXA_IOC_DISABLING},
    Choice{"disabled",    HXA_IOC_DISABLED},
    Choice{"fwmismatch",  HXA_IOC_FWMISMATCH},
};

inline constexpr std::array port_state_words{
    Choice{"uninit",           HXA_PPORT_ST_UNINIT},
    Choice{"enabling-qwait",   HXA_PPORT_ST_ENABLING_QWAIT},
    Choice{"enabling",         HXA_PPORT_ST_ENABLING},
    Choice{"linkdown",         HXA_PPORT_ST_LINKDOWN},
    Choice{"linkup",           HXA_PPORT_ST_LINKUP},
    Choice{"disabling-qwait",  HXA_PPORT_ST_DISABLING_QWAIT},
    Choice{"disabling",        HXA_PPORT_ST_DISABLING},
    Choice{"disabled",         HXA_PPORT_ST_DISABLED},
    Choice{"stopped",          HXA_PPORT_ST_STOPPED},
    Choice{"iocdown",          HXA_PPORT_ST_IOCDOWN},
    Choice{"iocdis",           HXA_PPORT_ST_IOCDIS},
    Choice{"fwmismatch",       HXA_PPORT_ST_FWMISMATCH},
    Choice{"preboot-disabled", HXA_PPORT_ST_PREBOOT_DISABLED},
};

inline constexpr std::array port_type_words{
    Choice{"unknown", HXA_PPORT_TYPE_UNKNOWN},
    Choice{"trunked", HXA_PPORT_TYPE_TRUNKED},
    Choice{"nport",   HXA_PPORT_TYPE_NPORT},
    Choice{"nlport",  HXA_PPORT_TYPE_NLPORT},
    Choice{"lport",   HXA_PPORT_TYPE_LPORT},
    Choice{"p2p",     HXA_PPORT_TYPE_P2P},
    Choice{"vport",   HXA_PPORT_TYPE_VPORT},
};

inline constexpr std::array topology_words{
    Choice{"none", HXA_PPORT_TOPOLOGY_NONE},
    Choice{"p2p",  HXA_PPORT_TOPOLOGY_P2P},
    Choice{"loop", HXA_PPORT_TOPOLOGY_LOOP},
    Choice{"auto", HXA_PPORT_TOPOLOGY_AUTO},
};

inline constexpr std::array flash_part_words{
    Choice{"optrom",  HXA_FLASH_PART_OPTROM},
    Choice{"fwimg",   HXA_FLASH_PART_FWIMG},
    Choice{"fwcfg",   HXA_FLASH_PART_FWCFG},
    Choice{"drv",     HXA_FLASH_PART_DRV},
    Choice{"boot",    HXA_FLASH_PART_BOOT},
    Choice{"asic",    HXA_FLASH_PART_ASIC},
    Choice{"mfg",     HXA_FLASH_PART_MFG},
    Choice{"optrom2", HXA_FLASH_PART_OPTROM2},
    Choice{"vpd",     HXA_FLASH_PART_VPD},
    Choice{"pbc",     HXA_FLASH_PART_PBC},
    Choice{"bootovl", HXA_FLASH_PART_BOOTOVL},
};

inline constexpr std::array flash_status_words{
    Choice{"good",        HXA_FLASH_STATUS_GOOD},
    Choice{"not-present", HXA_FLASH_STATUS_NOT_PRESENT},
    Choice{"uninit",      HXA_FLASH_STATUS_UNINIT},
    Choice{"bad",         HXA_FLASH_STATUS_BAD},
    Choice{"empty",       HXA_FLASH_STATUS_EMPTY},
    Choice{"ckfail",      HXA_FLASH_STATUS_CKFAIL},
};

inline constexpr std::array remote_port_state_words{
    Choice{"uninit",      HXA_RPORT_UNINIT},
    Choice{"offline",     HXA_RPORT_OFFLINE},
    Choice{"plogi",       HXA_RPORT_PLOGI},
    Choice{"online",      HXA_RPORT_ONLINE},
    Choice{"plogi-retry", HXA_RPORT_PLOGI_RETRY},
    Choice{"nsquery",     HXA_RPORT_NSQUERY},
    Choice{"adisc",       HXA_RPORT_ADISC},
    Choice{"logo",        HXA_RPORT_LOGO},
    Choice{"logo-rcv",    HXA_RPORT_LOGORCV},
    Choice{"nsdisc",      HXA_RPORT_NSDISC},
};

inline constexpr std::array remote_port_function_words{
    Choice{"none",      0},
    Choice{"initiator", HXA_RPORT_INITIATOR},
    Choice{"target",    HXA_RPORT_TARGET},
    Choice{"both",      HXA_RPORT_INITIATOR | HXA_RPORT_TARGET},
};

inline constexpr std::array qos_priority_words{
    Choice{"unknown", HXA_QOS_UNKNOWN},
    Choice{"high",    HXA_QOS_HIGH},
    Choice{"medium",  HXA_QOS_MED},
    Choice{"low",     HXA_QOS_LOW},
};

inline constexpr std::array nexus_state_words{
    Choice{"offline",     HXA_ITNIM_OFFLINE},
    Choice{"prli-send",   HXA_ITNIM_PRLI_SEND},
    Choice{"prli-sent",   HXA_ITNIM_PRLI_SENT},
    Choice{"prli-retry",  HXA_ITNIM_PRLI_RETRY},
    Choice{"hcb-online",  HXA_ITNIM_HCB_ONLINE},
    Choice{"online",      HXA_ITNIM_ONLINE},
    Choice{"hcb-offline", HXA_ITNIM_HCB_OFFLINE},
    Choice{"initiator",   HXA_ITNIM_INITIATIOR},
};

inline constexpr std::array sfp_identifier_words{
    Choice{"gbic",     1},
    Choice{"soldered", 2},
    Choice{"sfp",      3},
};

inline constexpr std::array sfp_media_words{
    Choice{"unknown",     HXA_SFP_MEDIA_UNKNOWN},
    Choice{"cu",          HXA_SFP_MEDIA_CU},
    Choice{"lw",          HXA_SFP_MEDIA_LW},
    Choice{"sw",          HXA_SFP_MEDIA_SW},
    Choice{"el",          HXA_SFP_MEDIA_EL},
    Choice{"unsupported", HXA_SFP_MEDIA_UNSUPPORT},
};

inline constexpr std::array device_type_words{
    Choice{"disk",             disk},
    Choice{"tape",             tape},
    Choice{"processor",        processor},
    Choice{"cdrom",            cdrom},
    Choice{"changer",          changer},
    Choice{"array-controller", array_controller},
    Choice{"enclosure",        enclosure},
};

inline constexpr std::array unit_state_words{
    Choice{"ready",     static_cast<std::uint32_t>(Unit_State::ready)},
    Choice{"not-ready", static_cast<std::uint32_t>(Unit_State::not_ready)},
    Choice{"no-medium", static_cast<std::uint32_t>(Unit_State::no_medium)},
};

inline constexpr std::array identification_words{
    Choice{"naa",   static_cast<std::uint32_t>(Identification::naa)},
    Choice{"eui64", static_cast<std::uint32_t>(Identification::eui64)},
    Choice{"t10",   static_cast<std::uint32_t>(Identification::t10)},
    Choice{"name",  static_cast<std::uint32_t>(Identification::name)},
    Choice{"none",  static_cast<std::uint32_t>(Identification::none)},
};

inline constexpr std::array errno_words{
    Choice{"EINTR",  EINTR},
    Choice{"EIO",    EIO},
    Choice{"ENXIO",  ENXIO},
    Choice{"EBADF",  EBADF},
    Choice{"EAGAIN", EAGAIN},
    Choice{"ENOMEM", ENOMEM},
    Choice{"EACCES", EACCES},
    Choice{"EFAULT", EFAULT},
    Choice{"EBUSY",  EBUSY},
    Choice{"ENODEV", ENODEV},
    Choice{"EINVAL", EINVAL},
    Choice{"ENOTTY", ENOTTY},
};
// clang-format on

} // namespace hxasim
