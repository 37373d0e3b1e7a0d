#include "inventory/physical_asset_helper.h"

#include "inventory/adapter_walk.h"
#include "inventory/builder.h"
#include "inventory/physical_connector.h"
#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "PhysicalAssetHelper";

constexpr Walk_Row module_walk = {
    .source = log_source,
    .iocs = Iocs::of_card,
    .none = {LL_INFO, "No adapters in the system. "},
    .not_opened = {LL_ERR, "ERROR: Unable to open handle to Adapter id %d"},
    .no_ports = {LL_WARN, "There are no ports associated to Adapter id %d"},
    .no_ethernet = {LL_WARN, "hxal_adapter_get_ethioc failed for adapter Index: %d, Port=%d. "},
    .no_fc = {LL_WARN, "hxal_adapter_get_fcioc failed for adapter Index: %d, Port=%d. "},
    .no_ioc = {LL_WARN, "no ioc retrieved for adapter Index: %d, Port=%d. "},
};

void append_connector(Instance_Array& instances, const _sfpInfo& info) { instances.adopt(getPhysicalConnectorInstance(info)); }

constexpr Builder<const _sfpInfo> module_builders[] = {
    {CLASSID_PhysicalConnector, append_connector},
};

void append_module(Instance_Array& instances, classId_t id, const Open_Adapter& adapter, const Open_Port& port)
{
    sfp_mem_t memory = {};
    const hxal_t* ioc = port.ethernet ? port.ethernet.get() : port.fc.get();
    if (hxal_diag_sfp_query(ioc, &memory) != HXA_STATUS_OK)
    {
        ZMLR_LOG(LL_INFO, "hxal_diag_sfp_query failed for PortIndex =%d", port.index);
        return;
    }
    const _sfpInfo info = sfp_info(memory, adapter.is_cna, adapter.index, port.index);
    build(instances, module_builders, id, info, log_source, "Default case . Other classes ");
}

} // namespace

const PhysicalAssetHelper& PhysicalAssetHelper::getPhysicalAssetHelperObject()
{
    static constinit const PhysicalAssetHelper helper;
    return helper;
}

Instance_Array PhysicalAssetHelper::getInstancesByClass(classId_t id, const Inventory_Request& request) const
{
    const Scope_Trace trace(log_source);
    Instance_Array instances;
    for (Adapter_Walk adapters(module_walk, &request.wanted); adapters.next();)
    {
        for (Port_Walk ports(module_walk, adapters.adapter(), &request.wanted); ports.next();)
            append_module(instances, id, adapters.adapter(), ports.port());
    }
    return instances;
}

} // namespace zmlr
