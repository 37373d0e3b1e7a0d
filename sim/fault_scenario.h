// Reading a fault as scenarios and the control socket write it.
#pragma once

#include "sim/hxasim.h"
#include "sim/json_object.h"

namespace hxasim
{

// Throws std::runtime_error that names the place of what is wrong, also for a fault that could never do what it says.
Fault read_fault(Json_Object& object);

} // namespace hxasim
