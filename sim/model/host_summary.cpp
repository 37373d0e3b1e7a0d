#include "sim/model/host_summary.h"

namespace hxasim
{

namespace
{

Port_Summary summarize(const Host& host, const Port& port)
{
    Port_Summary summary{.sfp = port.sfp.present, .functions = {}};
    for (auto node : {Node::hxa, Node::hxn})
        for (const auto& ioc : host.iocs(node))
            if (ioc.port == &port)
                summary.functions.push_back(
                    {.node = node, .instance = ioc.instance, .ioc_state = *ioc.state, .port_state = port_state(ioc)});
    return summary;
}

} // namespace

std::vector<Card_Summary> summarize(const Host& host)
{
    std::vector<Card_Summary> cards;
    for (const auto& adapter : host.adapters())
    {
        cards.push_back({.serial = adapter.serial,
                         .model = adapter.model,
                         .plugged = adapter.plugged,
                         .option_rom = adapter.flash.optrom_enabled,
                         .ports = {}});
        for (const auto& port : adapter.ports)
            cards.back().ports.push_back(summarize(host, port));
    }
    return cards;
}

} // namespace hxasim
