#include "sim/model/host.h"

#include "hxal/records/ioc.h"
#include "hxal/records/port.h"

#include <algorithm>

namespace hxasim
{

namespace
{

constexpr hxa_iocfc_intr_attr_t usual_interrupts{.coalesce = HXA_TRUE, .latency = 225, .delay = 1125};

// The driver has booted and enabled the IOC once.
void count_start(hxa_ioc_stats_t& stats)
{
    stats.drv_stats.ioc_boots = 1;
    stats.drv_stats.ioc_enables = 1;
    stats.drv_stats.enable_reqs = 1;
    stats.drv_stats.enable_replies = 1;
    stats.fw_stats.cfg_reqs = 1;
    stats.fw_stats.enable_reqs = 1;
}

} // namespace

Host::Host(const std::array<Driver, 2>& drivers, std::vector<Adapter> adapters)
    : _drivers(drivers)
    , _adapters(std::move(adapters))
{
    for (auto& adapter : _adapters)
        for (std::size_t number = 0; number < adapter.ports.size(); ++number)
            add_port(adapter, static_cast<std::uint8_t>(number));
}

void Host::add_port(Adapter& adapter, std::uint8_t number)
{
    auto& port = adapter.ports[number];
    add({.node = Node::hxa,
         .type = adapter.converged() ? HXA_IOC_TYPE_FCoE : HXA_IOC_TYPE_FC,
         .instance = port.fc_instance,
         .adapter = &adapter,
         .port = &port,
         .port_number = number,
         .pci_function = number,
         .state = &port.ioc_state});
    if (!adapter.converged())
        return;
    add({.node = Node::hxn,
         .type = HXA_IOC_TYPE_LL,
         .instance = port.eth_instance,
         .adapter = &adapter,
         .port = &port,
         .port_number = number,
         .pci_function = static_cast<std::uint32_t>(adapter.ports.size()) + number,
         .state = &port.eth_ioc_state});
}

void Host::add(Ioc ioc)
{
    ioc.adapter_name = ioc.adapter->name;
    ioc.port_name = ioc.port->name;
    ioc.interrupts = usual_interrupts;
    count_start(ioc.stats);
    _iocs[static_cast<std::size_t>(ioc.node)].push_back(std::move(ioc));
}

void Host::name_adapter(const Ioc& told, const std::string& name)
{
    for (auto& ioc : _iocs[static_cast<std::size_t>(told.node)])
        if (ioc.adapter == told.adapter)
            ioc.adapter_name = name;
}

Ioc* Host::find(Node node, std::uint32_t instance)
{
    auto& iocs = _iocs[static_cast<std::size_t>(node)];
    auto found = std::find_if(iocs.begin(), iocs.end(), [&](const Ioc& ioc) { return ioc.instance == instance; });
    return found == iocs.end() ? nullptr : &*found;
}

void Host::raise(Ioc& ioc, hxa_aen_entry_t event)
{
    if (!driver(ioc.node).present)
        return;
    event.hxad_num = static_cast<std::int32_t>(ioc.instance);
    ioc.events.add(event);
    _event_news = true;
}

bool is_link_speed(std::uint32_t speed)
{
    constexpr std::uint32_t speeds[] = {HXA_PPORT_SPEED_1GBPS, HXA_PPORT_SPEED_2GBPS, HXA_PPORT_SPEED_4GBPS,
                                        HXA_PPORT_SPEED_8GBPS, HXA_PPORT_SPEED_10GBPS};
    return std::find(std::begin(speeds), std::end(speeds), speed) != std::end(speeds);
}

bool can_run_at(const Port& port, std::uint32_t speed)
{
    return speed == HXA_PPORT_SPEED_AUTO || (is_link_speed(speed) && speed <= port.speed_supported);
}

std::uint32_t& own_state(const Ioc& ioc) { return is_fibre_channel(ioc) ? ioc.port->state : ioc.port->eth_state; }

bool is_out_of_service(std::uint32_t state)
{
    return state == HXA_PPORT_ST_DISABLED || state == HXA_PPORT_ST_DISABLING || state == HXA_PPORT_ST_STOPPED;
}

std::uint32_t port_state(const Ioc& ioc)
{
    switch (*ioc.state)
    {
    case HXA_IOC_OPERATIONAL:
        return own_state(ioc);
    case HXA_IOC_DISABLED:
        return HXA_PPORT_ST_IOCDIS;
    case HXA_IOC_FWMISMATCH:
        return HXA_PPORT_ST_FWMISMATCH;
    default:
        return HXA_PPORT_ST_IOCDOWN;
    }
}

} // namespace hxasim
