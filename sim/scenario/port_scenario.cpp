#include "sim/scenario/port_scenario.h"

#include "sim/model/record_fields.h"
#include "sim/scenario/scenario_words.h"

#include <algorithm>
#include <limits>
#include <numeric>
#include <optional>

namespace hxasim
{

namespace
{

constexpr std::uint32_t max_address = 0xFFFFFF;
constexpr std::size_t max_virtual_ports = 255;

bool is_in_service(std::uint32_t state)
{
    return state == HXA_PPORT_ST_LINKUP || state == HXA_PPORT_ST_LINKDOWN || state == HXA_PPORT_ST_ENABLING ||
           state == HXA_PPORT_ST_ENABLING_QWAIT;
}

void set_configuration(Port& port, std::uint16_t max_frame_size)
{
    auto& configuration = port.configuration;
    configuration.topology = static_cast<std::uint8_t>(port.topology);
    configuration.speed = HXA_PPORT_SPEED_AUTO;
    configuration.maxfrsize = max_frame_size;
    configuration.rx_bbcredit = 8;
    configuration.tx_bbcredit = 8;
    configuration.trl_def_speed = HXA_PPORT_SPEED_1GBPS;
    configuration.path_tov = 30;
    configuration.q_depth = 32;
}

// The record is packed: its WWN cannot be referred to.
hxa_pport_rnid_t identification_of(const Port& port)
{
    wwn_t wwn = 0;
    put_address(wwn, port.pwwn);
    hxa_pport_rnid_t identification{};
    identification.wwn = wwn;
    identification.unittype = 0x0A; // a host
    return identification;
}

template <typename Block, typename Number>
void read_block(Json_Object& object, std::string_view key, Counters<Block, Number>& counters)
{
    counters.assign(object.numbers(key, counters.size, std::numeric_limits<Number>::max()));
}

// Numbers for all counters of a port, each another one.
class Rising_Numbers
{
public:
    explicit Rising_Numbers(std::optional<std::uint32_t> first) : _next(first) {}

    template <typename Block, typename Number> void give(Counters<Block, Number>& counters)
    {
        if (!_next)
            return;
        std::vector<std::uint64_t> numbers(counters.size);
        std::iota(numbers.begin(), numbers.end(), *_next);
        *_next += static_cast<std::uint32_t>(counters.size);
        counters.assign(numbers);
    }

private:
    std::optional<std::uint32_t> _next;
};

Nexus read_nexus(Json_Object object)
{
    auto flag = [&](std::string_view key) { return static_cast<std::uint8_t>(object.number(key, 255, 0)); };
    Nexus nexus;
    nexus.state = object.choice("state", nexus_state_words, max_u32, nexus.state);
    nexus.retry = flag("retry");
    nexus.task_retry_id = flag("task_retry_id");
    nexus.rec_support = flag("rec_support");
    nexus.conf_comp = flag("conf_comp");
    nexus.latency.min = object.number("latency_min", max_u32, 0);
    nexus.latency.max = object.number("latency_max", max_u32, 0);
    nexus.latency.avg = object.number("latency_sum", max_u32, 0);
    nexus.latency.count = object.number("latency_count", max_u32, 0);
    nexus.latency.clock_res = object.number("clock_resolution", max_u32, 0);
    read_block(object, "counters", nexus.counters);
    object.done();
    return nexus;
}

// Remote port number `index` behind a logical port; `targets` stand before it.
Remote_Port usual_remote_port(const Logical_Port& logical, std::size_t index, std::uint32_t targets)
{
    Remote_Port remote;
    auto high = static_cast<std::uint8_t>(index >> 8);
    auto low = static_cast<std::uint8_t>(index);
    remote.pwwn = {0x21, 0x00, high, 0x05, 0x1F, low, logical.pwwn[6], logical.pwwn[7]};
    remote.nwwn = {0x20, 0x00, high, 0x05, 0x1F, low, logical.pwwn[6], logical.pwwn[7]};
    remote.address = 0x200000 + static_cast<std::uint32_t>(index);
    remote.target = targets;
    return remote;
}

Remote_Port read_remote_port(Json_Object& object, Remote_Port remote)
{
    remote.pwwn = object.address("pwwn", remote.pwwn);
    remote.nwwn = object.address("nwwn", remote.nwwn);
    remote.symbolic_name = object.text("symbolic_name", 255, "");
    remote.address = object.number("address", max_address, remote.address);
    remote.state = object.choice("state", remote_port_state_words, max_u32, remote.state);
    remote.function = object.choice("function", remote_port_function_words, max_u32, remote.function);
    remote.frame_size = object.number("frame_size", max_u32, remote.frame_size);
    remote.speed = object.number("speed", max_u32, remote.speed);
    remote.qos_priority = object.choice("qos_priority", qos_priority_words, max_u32, remote.qos_priority);
    remote.qos_flow_id = object.number("qos_flow_id", max_u32, remote.qos_flow_id);
    remote.rate_limited = object.boolean("rate_limited", remote.rate_limited);
    remote.bus = object.number("bus", max_u32, remote.bus);
    remote.target = object.number("target", max_u32, remote.target);
    read_block(object, "counters", remote.counters);
    if (auto nexus = object.object("nexus"))
        remote.nexus = read_nexus(*nexus);
    read_units(object, remote);
    object.done();
    return remote;
}

void read_remote_ports(Json_Object& object, Logical_Port& logical)
{
    std::uint32_t targets = 0;
    for (auto& remote : object.objects("remote_ports", max_remote_ports))
    {
        auto index = logical.remote_ports.size();
        logical.remote_ports.push_back(read_remote_port(remote, usual_remote_port(logical, index, targets)));
        targets += logical.remote_ports.back().is_target();
    }
}

Logical_Port read_virtual_port(Json_Object& object, const Port& port)
{
    Logical_Port logical;
    auto number = static_cast<std::uint8_t>(port.virtual_ports.size() + 1);
    auto usual = port.pwwn;
    usual[1] = number;
    logical.pwwn = object.address("pwwn", usual);
    logical.nwwn = object.address("nwwn", port.nwwn);
    logical.symbolic_name = object.text("symbolic_name", 128, "virtual port " + std::to_string(number));
    logical.virtual_fabric = static_cast<std::uint16_t>(object.number("virtual_fabric", 0xFFFF, 0));
    logical.address = object.number("address", max_address, port.base_port.address + number);
    logical.roles = object.number("roles", max_u32, logical.roles);
    logical.preboot = object.boolean("preboot", false);
    logical.type = HXA_PPORT_TYPE_VPORT;
    read_block(object, "counters", logical.counters);
    read_remote_ports(object, logical);
    object.done();
    return logical;
}

} // namespace

void read_link(Json_Object& object, Port& port, bool converged)
{
    port.state = object.choice("state", port_state_words, max_u32, port.state);
    port.eth_state = converged ? object.choice("eth_state", port_state_words, max_u32, port.state) : port.state;
    port.link_state = is_in_service(port.state) ? port.state : std::uint32_t{HXA_PPORT_ST_LINKUP};
    port.speed_supported = object.number("speed_supported", max_u32, port.speed_supported);
    port.auto_speed = object.number("speed", max_u32, port.speed_supported);
    port.speed = port.auto_speed;
    port.type = object.choice("type", port_type_words, max_u32, port.type);
    port.auto_topology = object.choice("topology", topology_words, max_u32, port.topology);
    port.topology = port.auto_topology;
    if (converged)
        port.mtu = object.number("mtu", max_u32, 1500);
    set_configuration(port, static_cast<std::uint16_t>(object.number("max_frame_size", 0xFFFF, 2112)));
    port.beacon.set(object.boolean("beacon", false), object.boolean("link_beacon", false), 0);
    port.loopback_test = object.boolean("loopback_test", port.loopback_test);
}

void read_counters(Json_Object& object, Port& port, bool converged)
{
    auto counters = object.object("counters");
    if (!counters)
        return;
    Rising_Numbers rising(counters->number("from", max_u32 / 2));
    const auto read = [&](std::string_view key, auto& block)
    {
        rising.give(block);
        read_block(*counters, key, block);
    };
    if (converged)
    {
        read("ethernet", port.counters.ethernet);
        read("ethernet_function", port.counters.ethernet_function);
        read("fcoe", port.counters.fcoe);
    }
    else
    {
        read("fc", port.counters.fc);
        read("qos", port.counters.qos);
    }
    read("logical_port", port.base_port.counters);
    counters->done();
}

void read_fabric(Json_Object& object, Port& port)
{
    auto& base = port.base_port;
    base.pwwn = port.pwwn;
    base.nwwn = port.nwwn;
    base.symbolic_name = port.symbolic_name.substr(0, sizeof(hxa_port_cfg_t::sym_name));
    base.type = port.type;
    base.address = object.number("address", max_address, base.address);
    port.identification = identification_of(port);
    port.fabric_name = object.address("fabric_name", Wwn{0x10, 0x00, 0x00, 0x05, 0x1E, 0xF0, 0x00, 0x00});
    read_remote_ports(object, base);
    for (auto& virtual_port : object.objects("virtual_ports", max_virtual_ports))
        port.virtual_ports.push_back(read_virtual_port(virtual_port, port));
}

} // namespace hxasim
