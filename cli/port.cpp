#include "hxal/port.h"
#include "cli/commands.h"
#include "cli/field_text.h"
#include "cli/keep.h"
#include "cli/report.h"
#include "cli/sfp.h"
#include "cli/trees.h"
#include "cli/virtual_ports.h"
#include "cli/words.h"
#include "hxal/diag.h"

namespace hxa
{

namespace
{

// clang-format off
constexpr Column list_columns[] = {
    {"Port",      "port"},
    {"Type",      "type"},
    {"Port WWN",  "fc.wwn"},
    {"FC state",  "fc.state"},
    {"Speed",     "fc.speed_gbps", " Gbit/s"},
    {"MAC",       "ethernet.mac"},
    {"Eth state", "ethernet.state"},
    {"Name",      "name"},
    {"Beacon",    "fc.beacon"},
};

constexpr Column columns[] = {
    {"Port",                  "port"},
    {"Type",                  "type"},
    {"Name",                  "name"},
    {"Port WWN",              "fc.wwn"},
    {"Node WWN",              "fc.node_wwn"},
    {"Factory port WWN",      "fc.factory_wwn"},
    {"Factory node WWN",      "fc.factory_node_wwn"},
    {"FCoE MAC",              "fc.mac"},
    {"FC state",              "fc.state"},
    {"Speed",                 "fc.speed_gbps", " Gbit/s"},
    {"Speed supported",       "fc.speed_supported_gbps", " Gbit/s"},
    {"Speed configured",      "fc.configured.speed_gbps", " Gbit/s"},
    {"Topology",              "fc.topology"},
    {"Topology configured",   "fc.configured.topology"},
    {"Frame size configured", "fc.configured.max_frame_size_bytes", " bytes"},
    {"Port type",             "fc.port_type"},
    {"FC address",            "fc.address"},
    {"Address configured",    "fc.configured.hard_address"},
    {"Symbolic name",         "fc.symbolic_name"},
    {"Beacon",                "fc.beacon"},
    {"Link beacon",           "fc.link_beacon"},
    {"Trunked",               "fc.configured.trunked"},
    {"Quality of service",    "fc.configured.qos"},
    {"Target rate limit",     "fc.configured.rate_limit"},
    {"Path timeout",          "fc.configured.path_timeout_seconds", " s"},
    {"Queue depth",           "fc.configured.queue_depth"},
    {"FC IOC",                "fc.ioc.state"},
    {"Interface",             "ethernet.interface"},
    {"MAC",                   "ethernet.mac"},
    {"Current MAC",           "ethernet.current_mac"},
    {"Ethernet state",        "ethernet.state"},
    {"Ethernet speed",        "ethernet.speed_gbps", " Gbit/s"},
    {"MTU",                   "ethernet.mtu_bytes", " bytes"},
    {"Ethernet IOC",          "ethernet.ioc.state"},
};
// clang-format on

// A way to show ports: what is read of each, as a list for JSON, and the text.
template <typename Tree, typename Text>
void show(Session& session, const std::vector<Port>& ports, const Tree& tree_of, const Text& text_of)
{
    List trees;
    std::string text;
    for (const auto& port : ports)
    {
        trees.push_back(tree_of(session, port));
        text += (text.empty() ? "" : "\n") + text_of(trees.back());
    }
    session.answer(Object{{"ports", trees}}, text);
}

void list_ports(Session& session, const std::vector<Port>& ports)
{
    List trees;
    for (const auto& port : ports)
        trees.push_back(port_tree(session, port));
    session.answer(Object{{"ports", trees}}, table(trees, list_columns));
}

void set_beacon(const Port& port, const Port_Options& options)
{
    const auto on = read_switch(options.value) ? HXA_TRUE : HXA_FALSE;
    const auto what = "beacon of port " + port.name();
    require(options.link ? hxal_diag_beacon_swport(port.ioc(), on, options.seconds)
                         : hxal_diag_beacon_lport(port.ioc(), on, options.seconds),
            what);
}

hxa_status_t set_address(const hxal_t* ioc, const std::string& value)
{
    if (value == "any")
        return hxal_port_clr_hardalpa(ioc);
    return hxal_port_cfg_hardalpa(ioc, static_cast<std::uint8_t>(read_number(value, 0xEF, 16, "loop address")));
}

hxa_status_t set_trunk(Session& session, const Port& port, const std::string& value)
{
    const auto adapter = "adapter " + port.adapter.name();
    if (value == "off")
    {
        session.confirm("The trunk of " + adapter + " is parted: its link goes down.");
        return hxal_port_trunk_disable(port.ioc());
    }
    const auto ports = read_bits(value, 7, "port");
    session.confirm("The ports " + value + " of " + adapter + " become one link: their own links go down.");
    return hxal_port_trunk_enable(port.ioc(), ports);
}

hxa_status_t set(Session& session, const Port& port, const std::string& action, const std::string& value)
{
    if (action == "enable")
        return hxal_port_enable(port.ioc());
    if (action == "disable")
        return hxal_port_disable(port.ioc());
    if (action == "name")
        return hxal_ioc_set_name(port.ioc(), value.c_str());
    if (action == "speed")
        return hxal_port_cfg_speed(port.ioc(), read_speed(value));
    if (action == "topology")
        return hxal_port_cfg_topology(port.ioc(), read_topology(value));
    if (action == "frame-size")
        return hxal_port_cfg_maxfrsize(port.ioc(), static_cast<std::uint16_t>(read_number(value, 0xFFFF, 10, "frame size")));
    return action == "address" ? set_address(port.ioc(), value) : set_trunk(session, port, value);
}

void act(Session& session, const Port& port, const Port_Options& options)
{
    if (options.action == "beacon")
        set_beacon(port, options);
    else
    {
        if (options.action == "name")
            check_name(options.value, sizeof port.ioc()->port_name - 1);
        if (options.action == "disable")
            session.confirm("Port " + port.name() + " goes out of service" +
                            (port.fc && port.ethernet ? ", for storage and for the network." : "."));
        change(session, options.keep, [&] { require(set(session, port, options.action, options.value), "port " + port.name()); });
    }
    session.answer_change("port", port.name(), options.action, options.value);
}

} // namespace

void port(Session& session, const Port_Options& options)
{
    const Host host(session);
    if (options.action == "list")
        list_ports(session, host.ports(options.port));
    else if (options.action == "show")
        show(session, host.ports(options.port), port_tree, [](const Value& tree) { return details(tree, columns); });
    else if (options.action == "sfp")
        show(session, host.ports(options.port), sfp_tree, sfp_text);
    else if (options.action == "virtual")
        show_virtual_ports(session, host.ports(options.port), options.keep.file);
    else
        act(session, host.port(options.port), options);
}

} // namespace hxa
