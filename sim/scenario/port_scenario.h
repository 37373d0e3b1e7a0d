// Reading what a scenario says of one port: its link and configuration, its counters, its transceiver, and the fabric behind it.
#pragma once

#include "sim/model/adapter.h"
#include "sim/scenario/json.h"

namespace hxasim
{

// Each reads its keys of the port's object over what the port has already. Throws like Json_Object.
void read_link(Json_Object& object, Port& port, bool converged);
void read_counters(Json_Object& object, Port& port, bool converged);
void read_fabric(Json_Object& object, Port& port);                      // after the port's names and link
void read_sfp(Json_Object& object, Port& port, const Adapter& adapter); // the next port of the adapter

// The same for the units of a remote port, after its names.
void read_units(Json_Object& object, Remote_Port& remote);

} // namespace hxasim
