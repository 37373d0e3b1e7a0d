#include "inventory/port_helper.h"

#include "inventory/adapter_lookup.h"
#include "inventory/builder.h"
#include "inventory/fc_port.h"
#include "inventory/port_reading.h"
#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "PortHelper";

constexpr Walk_Row walk = {
    .log_source = log_source,
    .iocs = Iocs::fc,
    .none = {LL_INFO, "No adapters in the system. "},
    .not_opened = {LL_ERR, "ERROR: Unable to open handle to Adapter id %d"},
    .no_fc = {LL_WARN, "Unable to get the handler. Adapter=%d, Port=%d. "},
};

void append_port(Instance_Array& instances, const Port_Reading& reading)
{
    instances.adopt(Ref<Instance>(getFCPortInstance(reading.info).steal()));
}

constexpr Builder<const Port_Reading> builders[] = {
    {CLASSID_FCPort, append_port},
};

void append(Instance_Array& instances, classId_t id, const Open_Adapter& adapter, const Inventory_Request& request)
{
    const Scope_Trace trace(log_source, "getInstancesByAdapterId");
    for (Port_Walk ports(walk, adapter); ports.next();)
    {
        if (const std::optional<Port_Reading> reading = read_port(adapter, ports.port(), request))
            build(instances, builders, id, *reading, log_source, "Unhandled class support");
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
    for (Adapter_Walk adapters(walk); adapters.next();)
        append(instances, id, adapters.adapter(), request);
    return instances;
}

Instance_Array PortHelper::getInstancesByAdapterId(int index, classId_t id, const Inventory_Request& request) const
{
    Instance_Array instances;
    if (const std::optional<Open_Adapter> adapter = open_adapter(walk, index))
        append(instances, id, *adapter, request);
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
