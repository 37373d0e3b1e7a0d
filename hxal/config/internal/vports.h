// The virtual ports of an IOC entry.
#pragma once

#include "hxal/config/internal/state.h"

#include <optional>
#include <string_view>

namespace hxal::config
{

// Replaces the port with the same port WWN, or appends one, under the number given; without one a replaced port keeps its own
// and a new one takes the lowest that is free. Marks virtual ports present. Nothing happens when memory is short or the list is
// full.
void put_vport(Ioc_Entry& entry, const hxal_vf_config_t& port, std::optional<int> vidx);

// The same for a port as the file has it. Nothing happens without a port WWN.
void store_vport(Ioc_Entry& entry, std::string_view text, std::optional<int> vidx);

// Frees the port with that port WWN, if there is one. Marks virtual ports absent with the last one.
void drop_vport(Ioc_Entry& entry, wwn_t pwwn);

} // namespace hxal::config
