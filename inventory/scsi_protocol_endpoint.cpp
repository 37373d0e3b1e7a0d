#include "inventory/scsi_protocol_endpoint.h"

#include "inventory/class_id.h"
#include "inventory/port_states.h"
#include "inventory/property_text.h"
#include "inventory/provider_util.h"
#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "PortHelper";

} // namespace

Ref<ZEMLAR_SCSIProtocolEndpoint> getSCSIProtocolEndpointInstance(const _hbaPortInfo& info, bool is_initiator)
{
    const Scope_Trace trace(log_source);
    constexpr uint16 PROTOCOL_IF_TYPE_OTHER = 1;   // CIM_ProtocolEndpoint.ProtocolIFType
    constexpr uint16 CONNECTION_FIBRE_CHANNEL = 2; // CIM_SCSIProtocolEndpoint.ConnectionType
    constexpr uint16 ROLE_INITIATOR = 2;           // CIM_SCSIProtocolEndpoint.Role
    constexpr uint16 ROLE_TARGET = 3;

    Ref<ZEMLAR_SCSIProtocolEndpoint> endpoint(ZEMLAR_SCSIProtocolEndpoint::create());
    endpoint->CreationClassName.set(ProviderUtil::getClassName(CLASSID_SCSIProtocolEndpoint));
    endpoint->SystemCreationClassName.set(ProviderUtil::getClassName(CLASSID_ComputerSystem));
    endpoint->SystemName.set(property_text(info.host));
    endpoint->Name.set(info.address);
    endpoint->ElementName.set(info.address);
    endpoint->OperationalStatus.set({info.operational_status});
    endpoint->ProtocolIFType.set(PROTOCOL_IF_TYPE_OTHER);
    endpoint->OtherTypeDescription.set("SCSI");
    endpoint->ConnectionType.set(CONNECTION_FIBRE_CHANNEL);
    endpoint->Role.set(is_initiator ? ROLE_INITIATOR : ROLE_TARGET);
    endpoint->EnabledState.set(getEnabledState(info.operational_status));
    ZMLR_LOG(LL_DBG, "returned Instance of SCSIProtocolEndpoint. port WWN= %s", info.port_wwn);
    return endpoint;
}

} // namespace zmlr
