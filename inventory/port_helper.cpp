#include "inventory/port_helper.h"

#include "inventory/cim_values.h"
#include "inventory/hba_info.h"
#include "inventory/property_text.h"
#include "inventory/provider_util.h"
#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "PortHelper";
constexpr uint64 gigabit = 1'000'000'000;

// The host's text, looked up once for all ports of a request.
struct Host_Text
{
    Host_Text() { ProviderUtil::getHostInfo(text, sizeof text - 1); }
    char text[sizeof(_hbaPortInfo::host)] = {};
};

uint16 enabled_state(uint16 operational_status)
{
    switch (operational_status)
    {
    case OPERATIONAL_STATUS_STARTING:
        return ENABLED_STATE_QUIESCE;
    case OPERATIONAL_STATUS_STOPPING:
        return ENABLED_STATE_SHUTTING_DOWN;
    case OPERATIONAL_STATUS_STOPPED:
        return ENABLED_STATE_DISABLED;
    case OPERATIONAL_STATUS_IN_SERVICE:
        return ENABLED_STATE_ENABLED;
    case OPERATIONAL_STATUS_LOST_COMMUNICATION:
        return ENABLED_STATE_OFFLINE;
    default:
        return ENABLED_STATE_OTHER;
    }
}

void fill(_hbaPortInfo& info, const hxa_pport_attr_t& attributes, const Host_Text& host, int port)
{
    ProviderUtil::WWN2str(info.port_wwn, &attributes.pwwn);
    ProviderUtil::WWN2str(info.node_wwn, &attributes.nwwn);
    copy_text(info.address, info.port_wwn);
    copy_text(info.symbolic_name, attributes.port_symname);
    copy_text(info.host, host.text);
    info.operational_status = PortHelper::getPortState(attributes.port_state);
    info.port_type = PortHelper::getPortType(attributes.port_type);
    info.max_frame_size = attributes.pport_cfg.maxfrsize;
    info.speed = uint64{attributes.speed} * gigabit;
    info.max_speed = uint64{attributes.speed_supported} * gigabit;
    info.port_index = static_cast<uint16>(port);
}

void append(Instance_Array& instances, classId_t id, const _hbaPortInfo& info)
{
    switch (id)
    {
    case CLASSID_FCPort:
        instances.adopt(Ref<Instance>(PortHelper::getFCPortInstance(info).steal()));
        break;
    default:
        ZMLR_LOG(LL_INFO, "Unhandled class support");
    }
}

void append_port(Instance_Array& instances, classId_t id, hxal_adapter_t* adapter, int index, int port, const Host_Text& host)
{
    const Ioc_Handle ioc(hxal_adapter_get_fcioc(adapter, port));
    if (!ioc)
    {
        ZMLR_LOG(LL_WARN, "Unable to get the handler. Adapter=%d, Port=%d. ", index, port);
        return;
    }
    hxa_pport_attr_t attributes = {};
    if (hxal_port_get_attr(ioc.get(), &attributes) != HXA_STATUS_OK)
    {
        ZMLR_LOG(LL_INFO, "hxal_port_get_attr failed. Adapter=%d, Port=%d ", index, port);
        return;
    }
    _hbaPortInfo info;
    fill(info, attributes, host, port);
    append(instances, id, info);
}

void append_adapter(Instance_Array& instances, classId_t id, int index, const Host_Text& host)
{
    const Scope_Trace trace(log_source, "getInstancesByAdapterId");
    hxal_adapter_t* adapter = hxal_adapter_open_idx(index);
    if (!adapter)
    {
        ZMLR_LOG(LL_ERR, "ERROR: Unable to open handle to Adapter id %d", index);
        return;
    }
    const int ports = hxal_adapter_get_num_port(index);
    for (int port = 0; port < ports; port++)
        append_port(instances, id, adapter, index, port, host);
}

} // namespace

const PortHelper& PortHelper::getPortHelperObject()
{
    static constinit const PortHelper helper;
    return helper;
}

Instance_Array PortHelper::getInstancesByClass(classId_t id) const
{
    const Scope_Trace trace(log_source);
    Instance_Array instances;
    const int adapters = static_cast<int>(hxal_adapter_get_num());
    if (adapters == 0)
    {
        ZMLR_LOG(LL_INFO, "No adapters in the system. ");
        return instances;
    }
    const Host_Text host;
    for (int index = 1; index <= adapters; index++)
        append_adapter(instances, id, index, host);
    return instances;
}

Instance_Array PortHelper::getInstancesByAdapterId(int adapter, classId_t id) const
{
    Instance_Array instances;
    append_adapter(instances, id, adapter, Host_Text());
    return instances;
}

Instance_Array PortHelper::getFCPortInstancesByAdapter(const String& address) const
{
    const Scope_Trace trace(log_source);
    ZMLR_LOG(LL_INFO, "getFCPortInstancesByAdapter invoked with address= %s", address.c_str());
    const int adapter = ProviderUtil::getAdapterId(address);
    if (adapter == -1)
    {
        ZMLR_LOG(LL_WARN, "Failed to get adapterId");
        return Instance_Array();
    }
    return getInstancesByAdapterId(adapter, CLASSID_FCPort);
}

uint16 PortHelper::getPortState(uint32 port_state)
{
    const Scope_Trace trace(log_source);
    switch (port_state)
    {
    case HXA_PPORT_ST_ENABLING_QWAIT:
    case HXA_PPORT_ST_ENABLING:
        return OPERATIONAL_STATUS_STARTING;
    case HXA_PPORT_ST_LINKDOWN:
        return OPERATIONAL_STATUS_LOST_COMMUNICATION;
    case HXA_PPORT_ST_LINKUP:
        return OPERATIONAL_STATUS_IN_SERVICE;
    case HXA_PPORT_ST_DISABLING_QWAIT:
    case HXA_PPORT_ST_DISABLING:
        return OPERATIONAL_STATUS_STOPPING;
    case HXA_PPORT_ST_DISABLED:
    case HXA_PPORT_ST_STOPPED:
        return OPERATIONAL_STATUS_STOPPED;
    case HXA_PPORT_ST_IOCDOWN:
        return OPERATIONAL_STATUS_ERROR;
    default:
        return OPERATIONAL_STATUS_UNKNOWN;
    }
}

uint16 PortHelper::getPortType(uint32 port_type)
{
    const Scope_Trace trace(log_source);
    switch (port_type)
    {
    case HXA_PPORT_TYPE_TRUNKED:
    case HXA_PPORT_TYPE_NPORT:
    case HXA_PPORT_TYPE_P2P:
    case HXA_PPORT_TYPE_VPORT:
        return FC_PORT_TYPE_N;
    case HXA_PPORT_TYPE_NLPORT:
    case HXA_PPORT_TYPE_LPORT:
        return FC_PORT_TYPE_NL;
    default:
        return FC_PORT_TYPE_UNKNOWN;
    }
}

Ref<ZEMLAR_FCPort> PortHelper::getFCPortInstance(const _hbaPortInfo& info)
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
    port->EnabledState.set(enabled_state(info.operational_status));
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
