#include "inventory/fc_port.h"

#include "inventory/cim_values.h"
#include "inventory/port_states.h"
#include "inventory/property_text.h"
#include "inventory/provider_util.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "PortHelper";

} // namespace

Ref<ZEMLAR_FCPort> getFCPortInstance(const _hbaPortInfo& info)
{
    const Scope_Trace trace(log_source);
    constexpr uint16 NOT_RESTRICTED = 3;     // CIM_LogicalPort.UsageRestriction
    constexpr uint16 LINK_TECHNOLOGY_FC = 4; // CIM_NetworkPort.LinkTechnology
    const String address = info.address;
    const String name = String(info.node_wwn) + ":" + info.port_wwn;

    Ref<ZEMLAR_FCPort> port(ZEMLAR_FCPort::create());
    port->CreationClassName.set(ProviderUtil::getClassName(CLASSID_FCPort));
    port->SystemCreationClassName.set(ProviderUtil::getClassName(CLASSID_ComputerSystem));
    port->SystemName.set(property_text(info.host));
    port->DeviceID.set(address);
    port->PermanentAddress.set(address);
    port->Name.set(name);
    port->ElementName.set(name);
    port->Caption.set(property_text(info.symbolic_name));
    port->OperationalStatus.set({info.operational_status});
    port->EnabledState.set(getEnabledState(info.operational_status));
    port->EnabledDefault.set(ENABLED_STATE_ENABLED);
    port->PortType.set(info.port_type);
    port->UsageRestriction.set(NOT_RESTRICTED);
    port->Speed.set(info.speed);
    port->MaxSpeed.set(info.max_speed);
    port->SupportedMaximumTransmissionUnit.set(info.max_frame_size);
    port->PortNumber.set(info.port_index);
    port->LinkTechnology.set(LINK_TECHNOLOGY_FC);
    return port;
}

} // namespace zmlr
