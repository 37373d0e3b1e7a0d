// How a host stands, for a person to look at.
#pragma once

#include "sim/model/host.h"

namespace hxasim
{

struct Function_Summary
{
    Node node;
    std::uint32_t instance;
    std::uint32_t ioc_state;  // hxa_ioc_state_t
    std::uint32_t port_state; // hxa_pport_states_t, as it is reported
};

struct Port_Summary
{
    bool sfp;
    std::vector<Function_Summary> functions;
};

struct Card_Summary
{
    std::string serial;
    std::string model;
    bool plugged;
    bool option_rom; // is switched on
    std::vector<Port_Summary> ports;
};

// The cards in the order of the scenario.
std::vector<Card_Summary> summarize(const Host& host);

} // namespace hxasim
