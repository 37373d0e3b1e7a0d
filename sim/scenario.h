// A simulated host as its scenario describes it: what the drivers know about their adapters, before anybody asks.
//
// README.md documents the JSON form key by key. Values are kept as the driver delivers them: a WWN and a MAC as wire
// bytes, enumerations as their numbers, speeds in Gbit/s.
#pragma once

#include "sim/beacon.h"
#include "sim/counters.h"
#include "sim/fabric.h"
#include "sim/flash.h"
#include "sim/hxasim.h"
#include "sim/sfp.h"

#include "hxal/records/ethport.h"
#include "hxal/records/fcoe.h"
#include "hxal/records/port.h"
#include "hxal/records/port_config.h"
#include "hxal/records/port_stats.h"

#include <array>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace hxasim
{

using Mac = std::array<std::uint8_t, 6>;

enum class Node : std::uint8_t
{
    hxa,
    hxn
};
constexpr std::array<const char*, 2> node_paths = {"/dev/hxa", "/dev/hxn"};
constexpr const char* path_of(Node node) { return node_paths[static_cast<std::size_t>(node)]; }
constexpr std::optional<Node> node_at(std::string_view path)
{
    for (auto node : {Node::hxa, Node::hxn})
        if (path == path_of(node))
            return node;
    return std::nullopt;
}

// A driver tells its application about this many IOCs at most.
constexpr int max_instances = 128;

struct Driver
{
    bool present = true;
    std::uint32_t version = 0x1020;
    std::uint32_t version_status = 0;
    std::optional<std::uint32_t> instance_count; // unset: the highest instance plus one
};

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

enum class Adapter_Kind : std::uint32_t
{
    fc_hba,
    cna,
    mezzanine
};

struct Vpd
{
    std::uint8_t version = 1;
    std::uint8_t vendor = 0;
    std::vector<std::uint8_t> data; // at most 512 bytes
};

struct Adapter
{
    Adapter_Kind kind = Adapter_Kind::fc_hba;
    std::string serial;
    std::string name;
    std::string model;
    std::string model_descr;
    std::string manufacturer;
    std::string hwpath;
    std::string hw_version;
    std::string firmware_version;
    std::string fc_driver_version;
    std::string eth_driver_version;
    std::string bios_version;
    std::string efi_version;
    std::string fcode_version;
    std::string os_type;
    std::uint16_t device_id = 0;
    std::uint8_t max_speed = 0;
    std::uint16_t temperature = 45;
    bool cna_capable = false;
    bool is_mezz = false;
    bool plugged = true; // in the host, that is; its drivers know it only then
    Vpd vpd;
    Flash flash;
    std::vector<Port> ports;

    bool converged() const { return kind != Adapter_Kind::fc_hba; }
};

struct Scenario
{
    std::array<Driver, 2> drivers; // by Node
    std::vector<Adapter> adapters;
    std::vector<Fault> faults;

    Driver& driver(Node node) { return drivers[static_cast<std::size_t>(node)]; }
};

// The scenario written in `json`. Throws std::runtime_error that names the place of the first error.
Scenario parse_scenario(const std::string& json);

// The JSON text of a shipped scenario ("mixed") or of a file (anything with a slash or a dot in it). Throws
// std::runtime_error when there is no such file, or it is not a regular file of at most 16 MiB.
std::string read_scenario_file(const std::string& name_or_path);

} // namespace hxasim
