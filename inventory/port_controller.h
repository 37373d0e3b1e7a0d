// ZEMLAR_PortController: an adapter as the controller of its ports.
#pragma once

#include "inventory/hba_info.h"
#include "runtime/instance.h"
#include "schema/ZEMLAR_PortController.h"

namespace zmlr
{

// The controller of an adapter whose record is complete, its state included.
Ref<ZEMLAR_PortController> getPortControllerInstance(const _hbaInfo& info);

} // namespace zmlr
