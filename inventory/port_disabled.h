// Whether a port is out of service, for the diagnostics.
#pragma once

#include "runtime/string.h"

namespace zmlr
{

// True when the port with this address is disabled or being disabled. A MAC address (12 digits) names a converged port by its
// Ethernet side, any other text an FC port by its WWN. The FC side is asked first (one request), on a CNA then the Ethernet
// side; without an FC IOC only the Ethernet side counts. False for an unknown address and for a port that does not tell.
bool isPortDisabled(const String& address);

} // namespace zmlr
