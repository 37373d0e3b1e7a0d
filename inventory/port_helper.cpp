#include "inventory/port_helper.h"

#include "inventory/adapter_lookup.h"
#include "inventory/address_text.h"
#include "inventory/alarm_device.h"
#include "inventory/builder.h"
#include "inventory/fc_port.h"
#include "inventory/fc_port_statistics.h"
#include "inventory/logical_port_group.h"
#include "inventory/port_reading.h"
#include "inventory/remote_ports.h"
#include "inventory/scsi_protocol_endpoint.h"
#include "inventory/target_helper.h"
#include "runtime/log.h"
#include "runtime/trace.h"

#include <array>
#include <cstdio>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "PortHelper";

constexpr Walk_Row port_walk = {
    .source = log_source,
    .iocs = Iocs::fc,
    .none = {LL_INFO, "No adapters in the system. "},
    .not_opened = {LL_ERR, "ERROR: Unable to open handle to Adapter id %d"},
    .no_fc = {LL_WARN, "Unable to get the handler. Adapter=%d, Port=%d. "},
};

void append_port(Instance_Array& instances, const Port_Reading& reading) { instances.adopt(getFCPortInstance(reading.info)); }

void append_target_endpoint(Instance_Array& instances, const Port_Reading& reading, wwn_t remote_port)
{
    if (!reading.request.wanted.may_hold(remote_port))
        return;

    hxa_rport_attr_t attributes = {};
    const hxa_status_t status =
        hxal_rport_get_attr(reading.port.fc.get(), base_fabric, reading.attributes.pwwn, remote_port, &attributes);
    if (status != HXA_STATUS_OK)
    {
        ZMLR_LOG(LL_ERR, "hxal_rport_get_attr returned error -  %d", static_cast<int>(status));
        return;
    }
    if (attributes.scsi_function != HXA_RPORT_TARGET)
        return;

    _hbaPortInfo endpoint = reading.info;
    std::snprintf(endpoint.address, sizeof endpoint.address, "%s_%s", reading.info.port_wwn,
                  ProviderUtil::wwn_text(remote_port).c_str());
    instances.adopt(getSCSIProtocolEndpointInstance(endpoint, false));
}

void append_endpoints(Instance_Array& instances, const Port_Reading& reading)
{
    instances.adopt(getSCSIProtocolEndpointInstance(reading.info, true));
    const Remote_Ports remote_ports(reading.port.fc.get(), reading.attributes.pwwn, log_source, LL_DBG);
    for (const wwn_t remote_port : remote_ports.wwns())
        append_target_endpoint(instances, reading, remote_port);
}

void append_statistics(Instance_Array& instances, const Port_Reading& reading)
{
    // Which of its lists the library writes is decided by the IOC: there is room for the longer one.
    std::array<hxal_stats_long_t, HXAL_ETH_PORT_STATS> list = {};
    ZMLR_LOG(LL_DBG, "hxal_stats_count(pport_fc_stats)= %d", HXAL_FC_PORT_STATS);
    ZMLR_LOG(LL_DBG, "hxal_stats_count(pport_eth_stats)= %d", HXAL_ETH_PORT_STATS);
    const bool is_cna = reading.adapter.is_cna;
    if (hxal_port_get_stats(reading.port.fc.get(), list.data()) != HXA_STATUS_OK)
    {
        ZMLR_LOG(LL_WARN, "hxal_port_get_stats failed for %s port WWN= %s", is_cna ? "fcoe" : "fc", reading.info.port_wwn);
        return;
    }
    const prov_pport_stats_u statistics = is_cna ? eth_port_statistics(list) : fc_port_statistics(list);
    instances.adopt(getFCPortStatisticsInstance(reading.info, statistics, is_cna));
}

void append_group(Instance_Array& instances, const Port_Reading& reading)
{
    instances.adopt(getLogicalPortGroupInstance(reading.info));
}

// A mezzanine card has no light of its own.
void append_alarm_device(Instance_Array& instances, const Port_Reading& reading)
{
    hxa_ioc_attr_t attributes = {};
    if (hxal_ioc_get_attr(reading.port.fc.get(), &attributes) != HXA_STATUS_OK)
    {
        ZMLR_LOG(LL_ERR, "hxal_ioc_get_attr failed.");
        return;
    }
    if (!attributes.adapter_attr.is_mezz)
        instances.adopt(getAlarmDeviceInstance(reading.info, reading.attributes.beacon != HXA_FALSE));
}

template <classId_t id> void append_units(Instance_Array& instances, const Port_Reading& reading)
{
    const TargetHelper& targets = TargetHelper::getTargetHelperObject();
    instances.adopt(targets.getTargetInstances(reading.port.fc.get(), reading.info, id, reading.request));
}

constexpr Builder<const Port_Reading> port_builders[] = {
    {CLASSID_FCPort, append_port},
    {CLASSID_SCSIProtocolEndpoint, append_endpoints},
    {CLASSID_FCPortStatistics, append_statistics},
    {CLASSID_StorageExtent, append_units<CLASSID_StorageExtent>},
    {CLASSID_TapeDrive, append_units<CLASSID_TapeDrive>},
    {CLASSID_LogicalPortGroup, append_group},
    {CLASSID_AlarmDevice, append_alarm_device},
};

void append_ports(Instance_Array& instances, classId_t id, const Open_Adapter& adapter, const Inventory_Request& request)
{
    for (Port_Walk ports(port_walk, adapter, &request.wanted); ports.next();)
    {
        if (const std::optional<Port_Reading> reading = read_port(adapter, ports.port(), request))
            build(instances, port_builders, id, *reading, log_source, "Unhandled class support");
    }
}

} // namespace

const PortHelper& PortHelper::getPortHelperObject()
{
    static constinit const PortHelper helper;
    return helper;
}

Instance_Array PortHelper::getInstancesByClass(classId_t id, const Inventory_Request& request) const
{
    const Scope_Trace trace(log_source);
    Instance_Array instances;
    for (Adapter_Walk adapters(port_walk, &request.wanted); adapters.next();)
    {
        const Scope_Trace of_adapter(log_source, "getInstancesByAdapterId");
        append_ports(instances, id, adapters.adapter(), request);
    }
    return instances;
}

Instance_Array PortHelper::getInstancesByAdapterId(int index, classId_t id, const Inventory_Request& request) const
{
    const Scope_Trace trace(log_source);
    Instance_Array instances;
    if (const std::optional<Open_Adapter> adapter = open_adapter(port_walk, index))
        append_ports(instances, id, *adapter, request);
    return instances;
}

Instance_Array PortHelper::getFCPortInstancesByAdapter(const String& address, const Inventory_Request& request) const
{
    const Scope_Trace trace(log_source);
    ZMLR_LOG(LL_INFO, "getFCPortInstancesByAdapter invoked with address= %s", address.c_str());
    const int adapter = ProviderUtil::getAdapterId(address);
    if (adapter == -1)
    {
        ZMLR_LOG(LL_WARN, "Failed to get adapterId");
        return Instance_Array();
    }
    return getInstancesByAdapterId(adapter, CLASSID_FCPort, request);
}

} // namespace zmlr
