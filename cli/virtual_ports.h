// The virtual ports behind a port. No request lists them: they are those that the drivers' configuration file names.
#pragma once

#include "cli/host.h"
#include "cli/session.h"

#include <string>
#include <vector>

namespace hxa
{

// Answers with the virtual ports of the FC ports, each as the driver has it now; one that it does not have is "missing".
void show_virtual_ports(Session& session, const std::vector<Port>& ports, const std::string& file);

} // namespace hxa
