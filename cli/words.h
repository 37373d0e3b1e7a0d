// The values that a person writes on the command line. Each function throws Failure (Exit::usage), with the words that it takes,
// for any other text.
#pragma once

#include "hxal/records/port.h"

#include <cstdint>
#include <string>

namespace hxa
{

bool read_switch(const std::string& text);                   // on, off
hxa_pport_speed_t read_speed(const std::string& text);       // auto, or Gbit/s: 1, 2, 4, 8, 10
hxa_pport_topology_t read_topology(const std::string& text); // p2p, loop, auto

// A name that fits into a field with room for so many bytes, that no terminal takes for a command and no configuration file for
// more than a name.
void check_name(const std::string& text, std::size_t most);

// A number in base 10 or 16, up to `most`; `what` names it.
std::uint32_t read_number(const std::string& text, std::uint32_t most, int base, const std::string& what);

// The bits of numbers with "," between them, each up to `most`, 31 at most.
std::uint32_t read_bits(const std::string& text, std::uint32_t most, const std::string& what);

} // namespace hxa
