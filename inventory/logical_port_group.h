// ZEMLAR_LogicalPortGroup: the group of the ports that share a node, one for each of its FC ports.
#pragma once

#include "inventory/hba_port_info.h"
#include "runtime/instance.h"
#include "schema/ZEMLAR_LogicalPortGroup.h"

namespace zmlr
{

Ref<ZEMLAR_LogicalPortGroup> getLogicalPortGroupInstance(const _hbaPortInfo& info);

} // namespace zmlr
