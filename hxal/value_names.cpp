#include "hxal/value_names.h"

#include "hxal/records/ethport.h"
#include "hxal/records/flash.h"
#include "hxal/records/ioc.h"
#include "hxal/records/itnim.h"
#include "hxal/records/port.h"
#include "hxal/records/rport.h"
#include "hxal/records/sfp.h"

#include <cstddef>

namespace
{

struct Text
{
    uint32_t value;
    const char* text;
};

// clang-format off
constexpr Text flash_statuses[] = {
    {HXA_FLASH_STATUS_GOOD,        "good"},
    {HXA_FLASH_STATUS_NOT_PRESENT, "absent"},
    {HXA_FLASH_STATUS_UNINIT,      "uninit"},
    {HXA_FLASH_STATUS_BAD,         "bad"},
    {HXA_FLASH_STATUS_EMPTY,       "empty"},
    {HXA_FLASH_STATUS_CKFAIL,      "badcksum"},
};

constexpr Text power_states[] = {
    {HXA_PM_DS_D0, "full"},
    {HXA_PM_DS_D1, "save1"},
    {HXA_PM_DS_D2, "save2"},
    {HXA_PM_DS_D3, "off"},
};

constexpr Text flash_part_types[] = {
    {0,                      "null"},
    {HXA_FLASH_PART_OPTROM,  "optrom"},
    {HXA_FLASH_PART_FWIMG,   "fw"},
    {HXA_FLASH_PART_FWCFG,   "cfg"},
    {HXA_FLASH_PART_DRV,     "drv"},
    {HXA_FLASH_PART_BOOT,    "boot"},
    {HXA_FLASH_PART_ASIC,    "asic"},
    {HXA_FLASH_PART_MFG,     "mfg"},
    {HXA_FLASH_PART_OPTROM2, "optrom2"},
    {HXA_FLASH_PART_VPD,     "vpd"},
    {HXA_FLASH_PART_PBC,     "pbc"},
    {HXA_FLASH_PART_BOOTOVL, "bootovl"},
};

constexpr Text ioc_states[] = {
    {HXA_IOC_RESET,       "reset"},
    {HXA_IOC_SEMWAIT,     "semwait"},
    {HXA_IOC_HWINIT,      "hwinit"},
    {HXA_IOC_FWMISMATCH,  "firmware mismatch"},
    {HXA_IOC_GETATTR,     "getattr"},
    {HXA_IOC_OPERATIONAL, "operational"},
    {HXA_IOC_INITFAIL,    "hwfail"},
    {HXA_IOC_HBFAIL,      "hbfail"},
    {HXA_IOC_DISABLING,   "disabling"},
    {HXA_IOC_DISABLED,    "disabled"},
};

constexpr Text port_states[] = {
    {0,                             "Unknown"},
    {HXA_PPORT_ST_UNINIT,           "Uninit"},
    {HXA_PPORT_ST_ENABLING_QWAIT,   "Enabling (qwait)"},
    {HXA_PPORT_ST_ENABLING,         "Enabling"},
    {HXA_PPORT_ST_LINKDOWN,         "Linkdown"},
    {HXA_PPORT_ST_LINKUP,           "Linkup"},
    {HXA_PPORT_ST_DISABLING_QWAIT,  "Disabling (qwait)"},
    {HXA_PPORT_ST_DISABLING,        "Disabling"},
    {HXA_PPORT_ST_DISABLED,         "Disabled"},
    {HXA_PPORT_ST_STOPPED,          "Stopped"},
    {HXA_PPORT_ST_IOCDOWN,          "IOC down"},
    {HXA_PPORT_ST_IOCDIS,           "IOC disabled"},
    {HXA_PPORT_ST_FWMISMATCH,       "FW mismatch"},
    {HXA_PPORT_ST_PREBOOT_DISABLED, "Disabled#"},
    {HXA_PPORT_ST_MAX_STATE,        "Invalid"},
};

constexpr Text port_speeds[] = {
    {HXA_PPORT_SPEED_UNKNOWN, "---"},
    {HXA_PPORT_SPEED_1GBPS,   "1G "},
    {HXA_PPORT_SPEED_2GBPS,   "2G "},
    {HXA_PPORT_SPEED_4GBPS,   "4G "},
    {HXA_PPORT_SPEED_8GBPS,   "8G "},
    {HXA_PPORT_SPEED_10GBPS,  "10G"},
    {HXA_PPORT_SPEED_AUTO,    "Auto"},
};

constexpr Text port_types[] = {
    {HXA_PPORT_TYPE_UNKNOWN, "UN"},
    {HXA_PPORT_TYPE_TRUNKED, "trunked"},
    {HXA_PPORT_TYPE_NPORT,   "N"},
    {HXA_PPORT_TYPE_NLPORT,  "NL"},
    {HXA_PPORT_TYPE_LPORT,   "LP"},
    {HXA_PPORT_TYPE_P2P,     "P2P"},
    {HXA_PPORT_TYPE_VPORT,   "VP"},
};

constexpr Text port_topologies[] = {
    {HXA_PPORT_TOPOLOGY_NONE, "Unknown"},
    {HXA_PPORT_TOPOLOGY_P2P,  "P2P"},
    {HXA_PPORT_TOPOLOGY_LOOP, "Loop"},
    {HXA_PPORT_TOPOLOGY_AUTO, "Auto"},
};

constexpr Text remote_port_states[] = {
    {HXA_RPORT_UNINIT,      "uninit"},
    {HXA_RPORT_OFFLINE,     "offline"},
    {HXA_RPORT_PLOGI,       "plogi"},
    {HXA_RPORT_ONLINE,      "online"},
    {HXA_RPORT_PLOGI_RETRY, "retry"},
    {HXA_RPORT_NSQUERY,     "nsquery"},
    {HXA_RPORT_ADISC,       "adisc"},
    {HXA_RPORT_LOGO,        "logo"},
    {HXA_RPORT_LOGORCV,     "logorecv"},
    {HXA_RPORT_NSDISC,      "nsdisc"},
};

constexpr Text nexus_states[] = {
    {HXA_ITNIM_OFFLINE,     "offline"},
    {HXA_ITNIM_PRLI_SEND,   "prli send"},
    {HXA_ITNIM_PRLI_SENT,   "prli sent"},
    {HXA_ITNIM_PRLI_RETRY,  "prli retry"},
    {HXA_ITNIM_HCB_ONLINE,  "online callback"},
    {HXA_ITNIM_ONLINE,      "online"},
    {HXA_ITNIM_HCB_OFFLINE, "offline callback"},
    {HXA_ITNIM_INITIATIOR,  "initiator"},
};

constexpr Text authentication_statuses[] = {
    {0, "no_auth"},
    {1, "uninit"},
    {2, "neg_send"},
    {3, "chal_wait"},
    {4, "neg_retry"},
    {5, "reply_send"},
    {6, "status_wait"},
    {7, "success"},
    {8, "failed"},
    {9, "unknown"},
};

constexpr Text reject_codes[] = {
    {1, "Auth fail"},
    {2, "Logical err"},
};

constexpr Text reject_explanations[] = {
    {1,  "Auth Mech"},
    {2,  "DH Group"},
    {3,  "Hash Func"},
    {4,  "Auth XACT"},
    {5,  "Auth fail"},
    {6,  "Payload"},
    {7,  "Proto msg"},
    {8,  "Restart Auth"},
    {9,  "Auth Concat"},
    {10, "Proto Ver."},
};

constexpr Text virtual_port_states[] = {
    {0, "uninit"},
    {1, "offline"},
    {2, "fdisc*"},
    {3, "fdisc"},
    {4, "fdisc-retry"},
    {5, "online"},
    {6, "deleting"},
    {7, "logo*"},
    {8, "logo"},
    {9, "Error"},
};

constexpr Text log_severities[] = {
    {HXA_LOG_INVALID,  "invalid"},
    {HXA_LOG_CRITICAL, "Critical"},
    {HXA_LOG_ERROR,    "Error"},
    {HXA_LOG_WARNING,  "Warning"},
    {HXA_LOG_INFO,     "Info"},
};

constexpr Text qos_states[] = {
    {0,               "Unknown"},
    {HXA_QOS_ONLINE,  "Online"},
    {HXA_QOS_OFFLINE, "Offline"},
};

constexpr Text qos_priorities[] = {
    {HXA_QOS_UNKNOWN, "Unknown"},
    {HXA_QOS_HIGH,    "High"},
    {HXA_QOS_MED,     "Medium"},
    {HXA_QOS_LOW,     "Low"},
};

constexpr Text link_down_reasons[] = {
    {20, "Timeout waiting to receive from peer"},
    {21, "Received LLDP shutdown TLV from peer"},
    {22, "Peer not advertising DCBX"},
    {23, "Peer not advertising PG TLV"},
    {24, "Peer not advertising PFC TLV"},
    {25, "Peer not advertising FCOE TLV"},
    {26, "Protocol Error - PG values not compatible"},
    {27, "Protocol Error - PFC values not compatible"},
    {28, "Protocol Error - FCOE values not compatible"},
    {29, "Invalid PGID values received [Valid values 0-7]"},
    {30, "Invalid BW values received [Sum of all BW should equal to 100]"},
    {31, "Invalid PFC values received [PFCs should be consistent within a priority group]"},
    {32, "Invalid FCoE values received [Atleast one FCoE priority(s) must be set]"},
    {33, "PFC disabled for FCoE priority(s)"},
    {34, "Protocol Error - Duplicate Control TLVs received"},
    {35, "Protocol Error - Duplicate Feature TLVs received"},
    {36, "Applying new configuration in progress. Please retry"},
    {37, "Protocol Initialization in progress Or Waiting to receive from Peer"},
    {38, "Physical link down"},
};

constexpr Text cee_states[] = {
    {HXA_ETHPORT_CEE_LINKDOWN, "Linkdown"},
    {HXA_ETHPORT_CEE_LINKUP,   "Linkup"},
};

// The port log keeps its names in fields of 8 bytes.
using Log_Name = char[8];

constexpr Log_Name log_modules[] = {
    "Invalid", "Debug", "Driver", "HAL", "FCXP", "UF", "FCS", "LPS", "Max",
};

constexpr Log_Name log_events[] = {
    "Invalid", "iocstop", "iocstrt", "pstop",  "pstart", "pstchg", "Tx",      "Tx_Ack1",
    "Tx_Rjt",  "Tx_Bsy",  "Rx",      "Rx_Ack1", "Rx_Rjt", "Rx_Bsy", "ct_in",   "ct_out",
    "drvstrt", "rscn",    "debug",   "misc",   "fcfdisc", "fcfcvl", "login",  "logout",
    "",
};

constexpr Text sfp_media[] = {
    {HXA_SFP_MEDIA_UNKNOWN,   "--"},
    {HXA_SFP_MEDIA_CU,        "cu"},
    {HXA_SFP_MEDIA_LW,        "lw"},
    {HXA_SFP_MEDIA_SW,        "sw"},
    {HXA_SFP_MEDIA_EL,        "el"},
    {HXA_SFP_MEDIA_UNSUPPORT, "us"},
};
// clang-format on

template <std::size_t Rows> const char* text_of(const Text (&table)[Rows], uint32_t value, const char* otherwise = "unknown")
{
    for (const Text& row : table)
        if (row.value == value)
            return row.text;
    return otherwise;
}

template <std::size_t Rows> const char* name_at(const Log_Name (&table)[Rows], int index)
{
    return index >= 0 && static_cast<std::size_t>(index) < Rows ? table[index] : "";
}

} // namespace

const char* hxal_flash_status_to_string(uint32_t status) { return text_of(flash_statuses, status); }
const char* hxal_pm_ds_to_string(uint32_t state) { return text_of(power_states, state); }
const char* hxal_flash_part_type_to_string(uint32_t type) { return text_of(flash_part_types, type); }
const char* hxal_ioc_state_to_string(uint32_t state) { return text_of(ioc_states, state); }
const char* hxal_pport_states_to_string(uint32_t state) { return text_of(port_states, state); }
const char* hxal_pport_speed_to_string(uint32_t speed) { return text_of(port_speeds, speed); }
const char* hxal_pport_type_to_string(uint32_t type) { return text_of(port_types, type); }
const char* hxal_pport_topology_to_string(uint32_t topology) { return text_of(port_topologies, topology); }
const char* hxal_rport_state_to_string(uint32_t state) { return text_of(remote_port_states, state); }
const char* hxal_itnim_state_to_string(uint32_t state) { return text_of(nexus_states, state); }
const char* hxal_auth_status_to_string(uint32_t status) { return text_of(authentication_statuses, status); }
const char* hxal_auth_rej_code_to_string(uint32_t code) { return text_of(reject_codes, code); }
const char* hxal_auth_rej_code_exp_to_string(uint32_t code) { return text_of(reject_explanations, code); }
const char* hxal_vport_state_to_string(uint32_t state) { return text_of(virtual_port_states, state); }
const char* hxal_log_severity_to_string(uint32_t severity) { return text_of(log_severities, severity); }
const char* hxal_qos_state_to_string(uint32_t state) { return text_of(qos_states, state); }
const char* hxal_qos_priority_to_string(uint32_t priority) { return text_of(qos_priorities, priority); }
const char* hxal_pport_linkstate_rsn_to_string(uint32_t reason) { return text_of(link_down_reasons, reason); }
const char* hxal_ethport_cee_state_to_string(uint32_t state) { return text_of(cee_states, state); }
const char* hxal_get_sfp_media(uint32_t media) { return text_of(sfp_media, media, "--"); }
const char* hxa_plog_mid_strings(int index) { return name_at(log_modules, index); }
const char* hxa_plog_eid_strings(int index) { return name_at(log_events, index); }
