// What a test or a person does to the host behind the drivers' backs.
#include "sim/driver/simulator.h"
#include "sim/model/events.h"
#include "sim/model/state_changes.h"

#include <algorithm>
#include <stdexcept>

namespace hxasim
{

namespace
{

template <typename Item> Item& item_at(std::vector<Item>& items, std::size_t number, const char* what)
{
    if (number >= items.size())
        throw std::runtime_error("no " + std::string(what) + " " + std::to_string(number));
    return items[number];
}

} // namespace

Host& Simulator::loaded_host()
{
    if (!_host)
        throw std::runtime_error("no host is loaded");
    return *_host;
}

Adapter& Simulator::adapter(std::size_t number) { return item_at(loaded_host().adapters(), number, "adapter"); }

Port& Simulator::port(std::size_t adapter_number, std::size_t number)
{
    return item_at(adapter(adapter_number).ports, number, "port");
}

void Simulator::raise_event(const Event& event)
{
    auto lock = locked();
    auto node = node_at(event.node);
    auto* ioc = node ? loaded_host().find(*node, static_cast<std::uint32_t>(event.instance)) : nullptr;
    if (!ioc)
        throw std::runtime_error("no instance " + std::to_string(event.instance) + " of " + event.node);
    auto entry = make_event(*ioc, event.category, event.type, {.level = event.level});
    if (event.data.size() > sizeof(entry.aen_data))
        throw std::runtime_error("more than " + std::to_string(sizeof(entry.aen_data)) + " bytes of data");
    if (!event.data.empty())
        entry.aen_data = {};
    std::copy(event.data.begin(), event.data.end(), entry.aen_data.bytes);
    _host->raise(*ioc, entry);
    show_news();
}

std::uint64_t Simulator::lost_events(std::uint32_t application)
{
    auto lock = locked();
    std::uint64_t lost = 0;
    for (auto node : {Node::hxa, Node::hxn})
        for (const auto& ioc : loaded_host().iocs(node))
            lost += ioc.events.lost(application);
    return lost;
}

void Simulator::plug(std::size_t number, bool plugged)
{
    auto lock = locked();
    set_plugged(loaded_host(), adapter(number), plugged);
    show_news();
}

void Simulator::link(std::size_t adapter_number, std::size_t number, bool up)
{
    auto lock = locked();
    set_link(loaded_host(), port(adapter_number, number), up);
    show_news();
}

void Simulator::sfp(std::size_t adapter_number, std::size_t number, bool inserted)
{
    auto lock = locked();
    set_sfp(loaded_host(), port(adapter_number, number), inserted);
    show_news();
}

std::vector<Card_Summary> Simulator::cards()
{
    auto lock = locked();
    return _host ? summarize(*_host) : std::vector<Card_Summary>();
}

std::size_t Simulator::fault_count()
{
    auto lock = locked();
    return _faults.size();
}

} // namespace hxasim
