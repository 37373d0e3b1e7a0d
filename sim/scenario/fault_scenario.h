// Reading a fault as scenarios and the control socket write it.
#pragma once

#include "sim/model/fault.h"
#include "sim/scenario/json.h"

namespace hxasim
{

// Throws std::runtime_error that names the place of what is wrong.
Fault read_fault(Json_Object& object);

} // namespace hxasim
