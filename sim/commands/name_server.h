// The name server of the simulated fabric (FC-GS-6), as far as a host asks it: the symbolic name of a port by its address.
#pragma once

#include "sim/model/fabric.h"

#include <span>

namespace hxasim
{

// The answer to a CT request of a logical port: an accept with what was asked for, or a reject with its reason.
std::vector<std::uint8_t> ask_name_server(const Logical_Port& asking, std::span<const std::uint8_t> request);

} // namespace hxasim
