// Reading what a scenario says of one port: its link and configuration, its counters, and the fabric behind it.
#pragma once

#include "sim/json_object.h"
#include "sim/scenario.h"

namespace hxasim
{

// Each reads its keys of the port's object over what the port has already. Throws like Json_Object.
void read_link(Json_Object& object, Port& port, bool converged);
void read_counters(Json_Object& object, Port& port, bool converged);
void read_fabric(Json_Object& object, Port& port); // after the port's names and link

} // namespace hxasim
