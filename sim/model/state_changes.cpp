#include "sim/model/state_changes.h"

#include "sim/model/events.h"

#include "hxal/records/ioc.h"
#include "hxal/records/port.h"

#include <stdexcept>

namespace hxasim
{

namespace
{

void raise(Host& host, Ioc& ioc, std::uint32_t category, std::uint32_t type, const Event_Subject& subject = {})
{
    host.raise(ioc, make_event(ioc, category, type, subject));
}

void tell_ioc(Host& host, Ioc& ioc)
{
    switch (*ioc.state)
    {
    case HXA_IOC_OPERATIONAL:
        return raise(host, ioc, HXA_AEN_CAT_IOC, HXA_IOC_AEN_ENABLE);
    case HXA_IOC_DISABLED:
        return raise(host, ioc, HXA_AEN_CAT_IOC, HXA_IOC_AEN_DISABLE);
    case HXA_IOC_HBFAIL:
        return raise(host, ioc, HXA_AEN_CAT_IOC, HXA_IOC_AEN_HBFAIL);
    case HXA_IOC_FWMISMATCH:
        return raise(host, ioc, HXA_AEN_CAT_IOC, HXA_IOC_AEN_FWMISMATCH);
    default: // on its way
        return;
    }
}

void tell_service(Host& host, Ioc& ioc, bool in_service)
{
    if (ioc.node == Node::hxn)
        raise(host, ioc, HXA_AEN_CAT_ETHPORT, in_service ? HXA_ETHPORT_AEN_ENABLE : HXA_ETHPORT_AEN_DISABLE);
    else
        raise(host, ioc, HXA_AEN_CAT_PORT, in_service ? HXA_PORT_AEN_ENABLE : HXA_PORT_AEN_DISABLE);
}

void tell_logical_port(Host& host, Ioc& ioc, Logical_Port& logical, bool on_line)
{
    on_line ? log_in(logical) : log_out(logical);
    raise(host, ioc, HXA_AEN_CAT_LPORT, on_line ? HXA_LPORT_AEN_ONLINE : HXA_LPORT_AEN_OFFLINE, {.logical = &logical});
    for (const auto& remote : logical.remote_ports)
        if (remote.known && remote.state == HXA_RPORT_ONLINE)
            tell_remote_port(host, ioc, logical, remote, on_line);
}

void tell_link(Host& host, Ioc& ioc, bool up)
{
    if (ioc.node == Node::hxn)
        return raise(host, ioc, HXA_AEN_CAT_ETHPORT, up ? HXA_ETHPORT_AEN_LINKUP : HXA_ETHPORT_AEN_LINKDOWN);
    raise(host, ioc, HXA_AEN_CAT_PORT, up ? HXA_PORT_AEN_ONLINE : HXA_PORT_AEN_OFFLINE);
    tell_logical_port(host, ioc, ioc.port->base_port, up);
    for (auto& logical : ioc.port->virtual_ports)
        tell_logical_port(host, ioc, logical, up);
}

void tell_module(Host& host, Ioc& ioc)
{
    const auto& module = ioc.port->sfp;
    raise(host, ioc, HXA_AEN_CAT_PORT, module.present ? HXA_PORT_AEN_SFP_INSERT : HXA_PORT_AEN_SFP_REMOVE);
    if (module.present && module.media == HXA_SFP_MEDIA_UNSUPPORT)
        raise(host, ioc, HXA_AEN_CAT_PORT, HXA_PORT_AEN_SFP_UNSUPPORT);
}

void start_link(Port& port)
{
    const auto& configuration = port.configuration;
    port.speed = configuration.speed == HXA_PPORT_SPEED_AUTO ? port.auto_speed : configuration.speed;
    port.topology = configuration.topology == HXA_PPORT_TOPOLOGY_AUTO ? port.auto_topology : configuration.topology;
}

void change_link(Host& host, Ioc& ioc, bool up)
{
    const auto before = function_state(ioc);
    auto& state = own_state(ioc);
    if (up && state == HXA_PPORT_ST_LINKDOWN)
        state = HXA_PPORT_ST_LINKUP;
    else if (!up && state == HXA_PPORT_ST_LINKUP)
        state = HXA_PPORT_ST_LINKDOWN;
    ioc.port->link_state = up ? HXA_PPORT_ST_LINKUP : HXA_PPORT_ST_LINKDOWN;
    follow(host, ioc, before);
}

template <typename Change> void for_functions(Host& host, const Port& port, Change change)
{
    for (auto node : {Node::hxa, Node::hxn})
        for (auto& ioc : host.iocs(node))
            if (ioc.port == &port)
                change(ioc);
}

// The first IOC whose driver is there and for which `matches` holds, FC functions first; null when there is none.
template <typename Matches> Ioc* first_ioc(Host& host, Matches matches)
{
    for (auto node : {Node::hxa, Node::hxn})
        for (auto& ioc : host.iocs(node))
            if (host.driver(node).present && matches(ioc))
                return &ioc;
    return nullptr;
}

} // namespace

Function_State function_state(const Ioc& ioc)
{
    return {.ioc = *ioc.state, .port = own_state(ioc), .link_up = port_state(ioc) == HXA_PPORT_ST_LINKUP};
}

void follow(Host& host, Ioc& ioc, const Function_State& before)
{
    const auto now = function_state(ioc);
    if (now.ioc != before.ioc)
        tell_ioc(host, ioc);
    if (is_out_of_service(now.port) != is_out_of_service(before.port))
        tell_service(host, ioc, !is_out_of_service(now.port));
    if (now.link_up == before.link_up)
        return;
    if (now.link_up)
        start_link(*ioc.port);
    tell_link(host, ioc, now.link_up);
}

void tell_remote_port(Host& host, Ioc& ioc, const Logical_Port& logical, const Remote_Port& remote, bool on_line)
{
    const Event_Subject subject{.logical = &logical, .remote = &remote};
    raise(host, ioc, HXA_AEN_CAT_RPORT, on_line ? HXA_RPORT_AEN_ONLINE : HXA_RPORT_AEN_OFFLINE, subject);
    if (remote.is_target())
        raise(host, ioc, HXA_AEN_CAT_ITNIM, on_line ? HXA_ITNIM_AEN_ONLINE : HXA_ITNIM_AEN_OFFLINE, subject);
}

void set_link(Host& host, const Port& port, bool up)
{
    if (up && !port.sfp.present)
        throw std::runtime_error("no SFP in the port");
    for_functions(host, port, [&](Ioc& ioc) { change_link(host, ioc, up); });
}

void set_sfp(Host& host, const Port& port, bool inserted)
{
    if (port.sfp.present == inserted)
        throw std::runtime_error(inserted ? "there is an SFP in the port" : "no SFP in the port");
    for_functions(host, port,
                  [&](Ioc& ioc)
                  {
                      ioc.port->sfp.present = inserted;
                      if (ioc.node == Node::hxa)
                          tell_module(host, ioc);
                      change_link(host, ioc, inserted && ioc.port->sfp.media != HXA_SFP_MEDIA_UNSUPPORT);
                  });
}

void set_plugged(Host& host, Adapter& adapter, bool plugged)
{
    if (adapter.plugged == plugged)
        throw std::runtime_error(plugged ? "the adapter is plugged" : "the adapter is not plugged");
    adapter.plugged = plugged;
    auto* own = first_ioc(host, [&](const Ioc& ioc) { return ioc.adapter == &adapter; });
    auto* other = first_ioc(host, [&](const Ioc& ioc) { return ioc.adapter != &adapter && ioc.adapter->plugged; });
    if (!own)
        return;
    // An application reads the events of the IOCs it knows: those of a new card are not among them.
    const auto event = make_event(*own, HXA_AEN_CAT_ADAPTER, plugged ? HXA_ADAPTER_AEN_ADD : HXA_ADAPTER_AEN_REMOVE);
    host.raise(other ? *other : *own, event);
}

} // namespace hxasim
