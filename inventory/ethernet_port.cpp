#include "inventory/ethernet_port.h"

#include "inventory/cim_values.h"
#include "inventory/class_id.h"
#include "inventory/port_states.h"
#include "inventory/property_text.h"
#include "inventory/provider_util.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "EthernetPortHelper";

// CIM_ManagedSystemElement.HealthState for an OperationalStatus.
uint16 health_of(uint16 operational_status)
{
    constexpr uint16 UNKNOWN = 0;
    constexpr uint16 OK = 5;
    constexpr uint16 DEGRADED = 10;
    constexpr uint16 MINOR_FAILURE = 15;
    switch (operational_status)
    {
    case OPERATIONAL_STATUS_ERROR:
        return MINOR_FAILURE;
    case OPERATIONAL_STATUS_STARTING:
    case OPERATIONAL_STATUS_IN_SERVICE:
        return OK;
    case OPERATIONAL_STATUS_STOPPING:
    case OPERATIONAL_STATUS_STOPPED:
    case OPERATIONAL_STATUS_LOST_COMMUNICATION:
        return DEGRADED;
    default:
        return UNKNOWN;
    }
}

} // namespace

Ref<ZEMLAR_EthernetPort> getEthernetPortInstance(const _ethPortInfo& info)
{
    const Scope_Trace trace(log_source);
    constexpr uint16 LINK_TECHNOLOGY_ETHERNET = 2; // CIM_NetworkPort.LinkTechnology
    constexpr uint16 CAPABILITY_UNKNOWN = 0;       // CIM_EthernetPort.Capabilities
    const String mac = info.mac;

    Ref<ZEMLAR_EthernetPort> port(ZEMLAR_EthernetPort::create());
    port->CreationClassName.set(ProviderUtil::getClassName(CLASSID_EthernetPort));
    port->SystemCreationClassName.set(ProviderUtil::getClassName(CLASSID_ComputerSystem));
    port->SystemName.set(property_text(info.host));
    port->DeviceID.set(mac);
    port->PermanentAddress.set(info.permanent_mac);
    port->NetworkAddresses.set({mac});
    port->LinkTechnology.set(LINK_TECHNOLOGY_ETHERNET);
    port->Capabilities.set({CAPABILITY_UNKNOWN});
    port->EnabledCapabilities.set({CAPABILITY_UNKNOWN});
    port->OperationalStatus.set({info.operational_status});
    port->PortType.set(info.port_type);
    port->ElementName.set(property_text(info.interface_name));
    port->PortNumber.set(info.port_index);
    return port;
}

Ref<ZEMLAR_LANEndpoint> getLANEndpointInstance(const _ethPortInfo& info)
{
    const Scope_Trace trace(log_source);
    constexpr uint16 PROTOCOL_IF_TYPE_OTHER = 1; // CIM_ProtocolEndpoint.ProtocolIFType
    const String name = property_text(info.interface_name);

    Ref<ZEMLAR_LANEndpoint> endpoint(ZEMLAR_LANEndpoint::create());
    endpoint->CreationClassName.set(ProviderUtil::getClassName(CLASSID_LANEndpoint));
    endpoint->SystemCreationClassName.set(ProviderUtil::getClassName(CLASSID_ComputerSystem));
    endpoint->SystemName.set(property_text(info.host));
    endpoint->Name.set(name);
    endpoint->ElementName.set(name);
    endpoint->Description.set(name);
    endpoint->LANID.set(name);
    endpoint->NameFormat.set(name + "_ETHERNET");
    endpoint->ProtocolIFType.set(PROTOCOL_IF_TYPE_OTHER);
    endpoint->MACAddress.set(info.mac);
    endpoint->MaxDataSize.set(info.mtu);
    endpoint->HealthState.set(health_of(info.operational_status));
    endpoint->EnabledState.set(getEnabledState(info.operational_status));
    return endpoint;
}

} // namespace zmlr
