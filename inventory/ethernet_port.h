// ZEMLAR_EthernetPort and ZEMLAR_LANEndpoint: the Ethernet side of one converged port, and what it speaks Ethernet with.
#pragma once

#include "inventory/ethernet_port_info.h"
#include "runtime/instance.h"
#include "schema/ZEMLAR_EthernetPort.h"
#include "schema/ZEMLAR_LANEndpoint.h"

namespace zmlr
{

Ref<ZEMLAR_EthernetPort> getEthernetPortInstance(const _ethPortInfo& info);
Ref<ZEMLAR_LANEndpoint> getLANEndpointInstance(const _ethPortInfo& info);

} // namespace zmlr
