// The pluggable transceiver of a port, from its memory (SFF-8472).
#pragma once

#include "cli/host.h"
#include "cli/session.h"

namespace hxa
{

// With "port" and, where the module could be read, what it tells of itself. The values that it monitors are there when it
// calibrates them itself.
Value sfp_tree(Session& session, const Port& port);
std::string sfp_text(const Value& tree);

} // namespace hxa
