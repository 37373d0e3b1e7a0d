// ZEMLAR_PhysicalConnector: the pluggable module in one port.
#pragma once

#include "inventory/sfp_info.h"
#include "runtime/instance.h"
#include "schema/ZEMLAR_PhysicalConnector.h"

namespace zmlr
{

Ref<ZEMLAR_PhysicalConnector> getPhysicalConnectorInstance(const _sfpInfo& info);

} // namespace zmlr
