// What the control socket is asked for: one line of JSON in, one out (README.md has the requests).
#pragma once

#include "sim/driver/simulator.h"

#include <string>
#include <string_view>

namespace hxasim
{

// {"ok": true, ...}, or {"ok": false, "error": "what is wrong"}. Throws std::bad_alloc and nothing else.
std::string answer_control(Simulator& simulator, std::string_view line);

} // namespace hxasim
