// Every counter that the drivers keep of a port, by name.
#pragma once

#include "cli/host.h"
#include "cli/session.h"

#include <cstdint>
#include <string>
#include <vector>

namespace hxa
{

struct Counter
{
    std::string name; // as the library has it; within a block not always unique
    std::uint64_t value;
};

struct Counter_Block
{
    std::string name; // "FC port", "Ethernet port", "FCoE", "logical port", "Ethernet function", "FC IOC", "Ethernet IOC"
    std::vector<Counter> counters;
};

// The blocks that the port has, in this order. One that cannot be read is told by Session::accept() and left out.
//     FC port            of an FC IOC
//     FCoE               of an FCoE IOC
//     Ethernet port      of an FCoE IOC, or of a port that has an Ethernet IOC alone
//     logical port       the base port's dealings with the name server and the management server of the fabric
//     Ethernet function  what the network driver counts
//     FC IOC, Ethernet IOC   what the driver and the firmware count of an IOC
std::vector<Counter_Block> counters_of(Session& session, const Port& port);

// Sets them to 0; throws at the first that is refused.
void reset_counters(const Port& port);

} // namespace hxa
