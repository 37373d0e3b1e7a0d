// ZEMLAR_FCPort: an FC port, on a CNA the FCoE side of a port.
#pragma once

#include "inventory/hba_port_info.h"
#include "runtime/instance.h"
#include "schema/ZEMLAR_FCPort.h"

namespace zmlr
{

Ref<ZEMLAR_FCPort> getFCPortInstance(const _hbaPortInfo& info);

} // namespace zmlr
