// ZEMLAR_AlarmDevice: the beacon of one FC port, the light by which a person finds it.
#pragma once

#include "inventory/hba_port_info.h"
#include "runtime/instance.h"
#include "schema/ZEMLAR_AlarmDevice.h"

namespace zmlr
{

Ref<ZEMLAR_AlarmDevice> getAlarmDeviceInstance(const _hbaPortInfo& info, bool is_on);

} // namespace zmlr
