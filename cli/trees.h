// What a card and a port are, read from the drivers: the trees that several commands show.
#pragma once

#include "cli/host.h"
#include "cli/session.h"

namespace hxa
{

// An answer that fails leaves its members out, and is told by Session::accept().
Object adapter_tree(Session& session, const Adapter& adapter);
Value port_tree(Session& session, const Port& port);

// A number of Gbit/s: null when it is unknown, "auto", or the number.
Value speed_value(std::uint32_t speed);

} // namespace hxa
