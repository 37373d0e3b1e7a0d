// A physical port: its functions, its link, its transceiver, and the fabric behind it.
//
// Values are kept as the driver delivers them: a WWN and a MAC as wire bytes, enumerations as their numbers, speeds in Gbit/s.
#pragma once

#include "sim/model/beacon.h"
#include "sim/model/counters.h"
#include "sim/model/fabric.h"
#include "sim/model/sfp.h"

#include "hxal/records/ethport.h"
#include "hxal/records/fcoe.h"
#include "hxal/records/port.h"
#include "hxal/records/port_config.h"
#include "hxal/records/port_stats.h"

#include <array>
#include <cstdint>
#include <string>
#include <vector>

namespace hxasim
{

using Mac = std::array<std::uint8_t, 6>;

// What the hardware and the drivers count on one port. An FC port counts `fc` and `qos`, a converged one the others.
struct Port_Counters
{
    Counters<hxa_pport_fc_stats_t, std::uint64_t> fc;
    Counters<hxa_fcqos_stats_t, std::uint32_t> qos;
    Counters<hxa_pport_eth_stats_t, std::uint64_t> ethernet;
    Counters<hxa_ethport_stats_t, std::uint64_t> ethernet_function;
    Counters<hxa_fcoe_stats_t, std::uint64_t> fcoe;
};

struct Port
{
    std::string name;
    std::string symbolic_name;
    std::string eth_name;
    Wwn pwwn{};
    Wwn nwwn{};
    Wwn factory_pwwn{};
    Wwn factory_nwwn{};
    Mac mac{}; // the Ethernet function's
    Mac factory_mac{};
    Mac current_mac{};
    Mac fcoe_mac{}; // the FCoE function's own
    Mac fcoe_factory_mac{};
    std::uint32_t state = 0;      // of the FC function
    std::uint32_t eth_state = 0;  // of the Ethernet function
    std::uint32_t link_state = 0; // of a function in service
    std::uint32_t speed = 0;      // of the link
    std::uint32_t auto_speed = 0; // that the link negotiates
    std::uint32_t speed_supported = 0;
    std::uint32_t type = 0;
    std::uint32_t topology = 0;      // of the link
    std::uint32_t auto_topology = 0; // that the link negotiates
    std::uint32_t mtu = 0;           // of the Ethernet function
    hxa_pport_cfg_t configuration{};
    hxa_pport_rnid_t identification{};
    Beacon beacon;
    bool led_test = false;      // one has its lights
    bool loopback_test = false; // one holds the port
    Sfp_Module sfp;
    Wwn fabric_name{};
    Logical_Port base_port;
    std::vector<Logical_Port> virtual_ports;
    Port_Counters counters;
    std::uint32_t ioc_state = 0;
    std::uint32_t eth_ioc_state = 0;
    std::uint32_t ioc_settle = 0; // attribute requests that see an IOC on its way, after an enable or a disable
    std::uint32_t fc_instance = 0;
    std::uint32_t eth_instance = 0; // of a converged adapter
};

} // namespace hxasim
