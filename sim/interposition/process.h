// The one simulator of the process, and its control socket.
#pragma once

#include "sim/driver/simulator.h"

namespace hxasim
{

// Both live as long as the process: other threads may still send requests while it exits. The control socket is served from
// the first use on, whatever host there will be.
Simulator& simulator();

// Serves the control socket at this path instead of where it was; an empty path ends it. Throws std::runtime_error.
void serve_control_at(const std::string& path);

} // namespace hxasim
