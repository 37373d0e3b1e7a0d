// What the drivers say of a port's state and type, in the values of CIM.
#pragma once

#include "runtime/types.h"

namespace zmlr
{

// CIM OperationalStatus for a port state (HXA_PPORT_ST_...) of an FC or Ethernet port.
uint16 getPortState(uint32 port_state);

// CIM EnabledState for that OperationalStatus.
uint16 getEnabledState(uint16 operational_status);

// CIM FC PortType for a port type (HXA_PPORT_TYPE_...).
uint16 getPortType(uint32 port_type);

} // namespace zmlr
