// What lies behind the FC function of a port: its logical ports, and the remote ports that they see in the fabric.
#pragma once

#include "sim/model/counters.h"
#include "sim/model/scsi_target.h"

#include "hxal/records/itnim.h"
#include "hxal/records/lport.h"
#include "hxal/records/rport.h"

#include <array>
#include <string>
#include <vector>

namespace hxasim
{

using Wwn = std::array<std::uint8_t, 8>;

// The nexus to a remote target.
struct Nexus
{
    std::uint32_t state = HXA_ITNIM_ONLINE; // while the remote port is online
    std::uint8_t retry = 0;
    std::uint8_t task_retry_id = 0;
    std::uint8_t rec_support = 0;
    std::uint8_t conf_comp = 0;
    hxa_itnim_latency_t latency{};
    Counters<hxa_itnim_stats_t, std::uint32_t> counters;
};

struct Remote_Port
{
    Wwn pwwn{};
    Wwn nwwn{};
    std::string symbolic_name;
    std::uint32_t address = 0;
    std::uint32_t state = HXA_RPORT_ONLINE; // while the link is up
    std::uint32_t function = HXA_RPORT_TARGET;
    std::uint32_t frame_size = 2048;
    std::uint32_t speed = 0;          // as it tells itself; 0: it does not
    std::uint32_t assigned_speed = 0; // as it is told
    std::uint32_t qos_priority = HXA_QOS_UNKNOWN;
    std::uint32_t qos_flow_id = 0;
    bool rate_limited = false;
    std::uint32_t bus = 0; // where the operating system shows it
    std::uint32_t target = 0;
    bool known = true; // to the driver
    Nexus nexus;
    Scsi_Target scsi; // of a target
    Counters<hxa_rport_stats_t, std::uint32_t> counters;

    bool is_target() const { return (function & HXA_RPORT_TARGET) != 0; }
};

struct Logical_Port
{
    Wwn pwwn{};
    Wwn nwwn{};
    std::string symbolic_name;
    std::uint16_t virtual_fabric = 0;
    std::uint32_t address = 0;
    std::uint32_t roles = HXA_PORT_ROLE_FCP_IM;
    std::uint32_t type = 0; // hxa_pport_type_t
    bool preboot = false;
    std::vector<Remote_Port> remote_ports;
    Counters<hxa_lport_stats_t, std::uint32_t> counters;
};

// A driver keeps this many remote ports of a logical port.
constexpr std::size_t max_remote_ports = 1024;

// The member with this port WWN; null when there is none. The WWN is in memory order, as a record has it.
template <typename Ports> auto* port_with_wwn(Ports& ports, wwn_t wwn)
{
    decltype(&*ports.begin()) found = nullptr;
    for (auto& port : ports)
        if (!found && std::memcmp(port.pwwn.data(), &wwn, sizeof(wwn)) == 0)
            found = &port;
    return found;
}

// The logical port has logged into the fabric, or lost it.
void log_in(Logical_Port& port);
void log_out(Logical_Port& port);

// The driver has logged into a remote port, or lost it; nothing while that is not online.
void log_in(Remote_Port& port);
void log_out(Remote_Port& port);

} // namespace hxasim
