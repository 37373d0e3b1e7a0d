#include "inventory/ethernet_port_helper.h"

#include "inventory/adapter_lookup.h"
#include "inventory/adapter_walk.h"
#include "inventory/builder.h"
#include "inventory/ethernet_port.h"
#include "inventory/property_text.h"
#include "inventory/sfp_info.h"
#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "EthernetPortHelper";

constexpr Walk_Row ethernet_walk = {
    .source = log_source,
    .iocs = Iocs::ethernet,
    .none = {LL_INFO, "No adapters in the system. "},
    .no_cna = {LL_INFO, "Adapter is not of CNA type. Continuing with the next one."},
    .not_opened = {LL_ERR, "ERROR: Unable to open handle to Adapter id %d"},
    .no_ethernet = {LL_WARN, "Unable to get the handler. Adapter=%d, Port=%d. "},
};

struct Ethernet_Reading
{
    const Open_Port& port;
    _ethPortInfo info = {};
};

std::optional<Ethernet_Reading> read_ethernet_port(const Open_Port& port, const Inventory_Request& request)
{
    hxa_ethport_attr_t attributes = {};
    if (hxal_ethport_get_attr(port.ethernet.get(), &attributes) != HXA_STATUS_OK)
    {
        ZMLR_LOG(LL_INFO, "hxal_ethport_get_attr failed. Adapter=%d, Port=%d ", port.adapter, port.index);
        return std::nullopt;
    }
    Ethernet_Reading reading = {.port = port};
    fill_ethernet_port(reading.info, port.ethernet.get(), attributes, port.index);
    copy_text(reading.info.host, request.host.text());
    return reading;
}

// A port without a module stays, with an unknown type.
void append_port(Instance_Array& instances, Ethernet_Reading& reading)
{
    sfp_mem_t memory = {};
    if (hxal_diag_sfp_query(reading.port.ethernet.get(), &memory) == HXA_STATUS_OK)
        reading.info.port_type = getEthernetPortType(ethernet_media(memory).c_str());
    else
        ZMLR_LOG(LL_INFO, "hxal_diag_sfp_query failed for PortIndex =%d", reading.port.index);
    instances.adopt(getEthernetPortInstance(reading.info));
}

void append_endpoint(Instance_Array& instances, Ethernet_Reading& reading)
{
    instances.adopt(getLANEndpointInstance(reading.info));
}

constexpr Builder<Ethernet_Reading> ethernet_builders[] = {
    {CLASSID_EthernetPort, append_port},
    {CLASSID_LANEndpoint, append_endpoint},
};

void append(Instance_Array& instances, classId_t id, const Open_Adapter& adapter, const Inventory_Request& request)
{
    for (Port_Walk ports(ethernet_walk, adapter, &request.wanted); ports.next();)
    {
        if (std::optional<Ethernet_Reading> reading = read_ethernet_port(ports.port(), request))
            build(instances, ethernet_builders, id, *reading, log_source, "Unhandled class support");
    }
}

} // namespace

const EthernetPortHelper& EthernetPortHelper::getEthernetPortHelperObject()
{
    static constinit const EthernetPortHelper helper;
    return helper;
}

Instance_Array EthernetPortHelper::getInstancesByClass(classId_t id, const Inventory_Request& request) const
{
    const Scope_Trace trace(log_source);
    Instance_Array instances;
    for (Adapter_Walk adapters(ethernet_walk, &request.wanted); adapters.next();)
    {
        const Scope_Trace of_adapter(log_source, "getInstancesByAdapterId");
        append(instances, id, adapters.adapter(), request);
    }
    return instances;
}

Instance_Array EthernetPortHelper::getInstancesByAdapterId(int index, classId_t id, const Inventory_Request& request) const
{
    const Scope_Trace trace(log_source);
    Instance_Array instances;
    if (const std::optional<Open_Adapter> adapter = open_adapter(ethernet_walk, index))
        append(instances, id, *adapter, request);
    return instances;
}

Instance_Array EthernetPortHelper::getEthernetPortInstancesByAdapter(const String& mac, const Inventory_Request& request) const
{
    const Scope_Trace trace(log_source);
    ZMLR_LOG(LL_INFO, "getEthernetPortInstancesByMacAddress invoked with MAC Address = %s", mac.c_str());
    const int adapter = ProviderUtil::getAdapterIdByMacAddr(mac);
    if (adapter == -1)
    {
        ZMLR_LOG(LL_WARN, "Failed to get adapterId");
        return Instance_Array();
    }
    return getInstancesByAdapterId(adapter, CLASSID_EthernetPort, request);
}

} // namespace zmlr
