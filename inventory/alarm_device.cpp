#include "inventory/alarm_device.h"

#include "inventory/cim_values.h"
#include "inventory/class_id.h"
#include "inventory/property_text.h"
#include "inventory/provider_util.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "PortHelper";

} // namespace

Ref<ZEMLAR_AlarmDevice> getAlarmDeviceInstance(const _hbaPortInfo& info, bool is_on)
{
    const Scope_Trace trace(log_source);
    constexpr uint16 URGENCY_INFORMATIONAL = 3; // CIM_AlarmDevice.Urgency

    Ref<ZEMLAR_AlarmDevice> device(ZEMLAR_AlarmDevice::create());
    device->DeviceID.set(info.address);
    device->CreationClassName.set(ProviderUtil::getClassName(CLASSID_AlarmDevice));
    device->SystemCreationClassName.set(ProviderUtil::getClassName(CLASSID_ComputerSystem));
    device->SystemName.set(property_text(info.host));
    device->Caption.set(property_text(info.symbolic_name));
    device->Urgency.set(URGENCY_INFORMATIONAL);
    device->AlarmState.set(is_on ? ALARM_STATE_ALTERNATING : ALARM_STATE_OFF);
    return device;
}

} // namespace zmlr
