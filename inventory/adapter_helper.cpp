#include "inventory/adapter_helper.h"

#include "inventory/builder.h"
#include "inventory/cim_values.h"
#include "inventory/hba_reading.h"
#include "inventory/port_controller.h"
#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "AdapterHelper";

constexpr Walk_Row walk = {
    .log_source = log_source,
    .iocs = Iocs::of_card,
    .count = {LL_INFO, "Number of Adapters: %d"},
    .none = {LL_INFO, "No adapters in the system!"},
    .not_opened = {LL_INFO, "Unable to open handle to Adapter id %d"},
    .kind = {LL_INFO, "Adapter Type : %s"},
    .no_ports = {LL_WARN, "There are no ports associated to Adapter id %d"},
    .no_ethernet = {LL_WARN, "hxal_adapter_get_ethioc failed for adapter Index: %d"},
    .no_fc = {LL_WARN, "hxal_adapter_get_fcioc failed for adapter Index: %d"},
    .no_ioc = {LL_WARN, "no ioc retrieved for adapter Index: %d"},
};

void append_controller(Instance_Array& instances, Hba_Reading& reading)
{
    const bool is_disabled = hxal_adapter_is_disabled(reading.port.adapter) != HXA_FALSE;
    reading.info.adapter_state = is_disabled ? OPERATIONAL_STATUS_STOPPED : OPERATIONAL_STATUS_IN_SERVICE;
    instances.adopt(Ref<Instance>(getPortControllerInstance(reading.info).steal()));
}

constexpr Builder<Hba_Reading> builders[] = {
    {CLASSID_PortController, append_controller},
};

} // namespace

const AdapterHelper& AdapterHelper::getAdapterHelperInstance()
{
    static constinit const AdapterHelper helper;
    return helper;
}

Instance_Array AdapterHelper::getInstancesByClass(classId_t id, const Inventory_Request& request) const
{
    const Scope_Trace trace(log_source);
    Instance_Array instances;
    Adapter_Walk adapters(walk);
    if (adapters.count() == 0)
        return instances;

    while (adapters.next())
    {
        std::optional<Open_Port> port = open_port(walk, adapters.adapter(), 0);
        if (!port)
            continue;
        if (std::optional<Hba_Reading> reading = read_hba(adapters.adapter(), std::move(*port), request))
            build(instances, builders, id, *reading, log_source, "Default case . Other classes ");
    }
    ZMLR_LOG(LL_INFO, "Number of instances: %d", static_cast<int>(instances.size()));
    return instances;
}

} // namespace zmlr
