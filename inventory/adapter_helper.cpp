#include "inventory/adapter_helper.h"

#include "inventory/adapter_software_identity.h"
#include "inventory/builder.h"
#include "inventory/cim_values.h"
#include "inventory/hba_reading.h"
#include "inventory/physical_package.h"
#include "inventory/port_controller.h"
#include "inventory/product.h"
#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "AdapterHelper";

constexpr Walk_Row adapter_walk = {
    .source = log_source,
    .iocs = Iocs::of_card,
    .ports = Ports::first,
    .count = {LL_INFO, "Number of Adapters: %d"},
    .none = {LL_INFO, "No adapters in the system!"},
    .not_opened = {LL_INFO, "Unable to open handle to Adapter id %d"},
    .kind = {LL_INFO, "Adapter Type : %s"},
    .no_ports = {LL_WARN, "There are no ports associated to Adapter id %d"},
    .no_ethernet = {LL_WARN, "hxal_adapter_get_ethioc failed for adapter Index: %d"},
    .no_fc = {LL_WARN, "hxal_adapter_get_fcioc failed for adapter Index: %d"},
    .no_ioc = {LL_WARN, "no ioc retrieved for adapter Index: %d"},
};

// One adapter, and what the walk has told before it.
struct Adapter_Reading
{
    Hba_Reading& adapter;
    const Wanted& wanted;
    bool& network_driver_is_told;
    bool& storage_driver_is_told;
};

void append_controller(Instance_Array& instances, Adapter_Reading& reading)
{
    _hbaInfo& info = reading.adapter.info;
    const bool is_disabled = hxal_adapter_is_disabled(reading.adapter.port.adapter) != HXA_FALSE;
    info.adapter_state = is_disabled ? OPERATIONAL_STATUS_STOPPED : OPERATIONAL_STATUS_IN_SERVICE;
    instances.adopt(getPortControllerInstance(info));
}

void append_package(Instance_Array& instances, Adapter_Reading& reading)
{
    instances.adopt(getPhysicalPackageInstance(reading.adapter.info));
}

void append_product(Instance_Array& instances, Adapter_Reading& reading)
{
    instances.adopt(getProductInstance(reading.adapter.info));
}

// A driver is the same for all its adapters: the first one whose attributes were read tells of it.
void append_driver(Instance_Array& instances, const _hbaInfo& info, bool is_read, bool is_ethernet, bool& is_told)
{
    if (!is_read || is_told)
        return;
    instances.adopt(getAdapterSoftwareIdentityInstance(info, SOFTWARE_DRIVER, is_ethernet));
    is_told = true;
}

// Whether the boot code in the card's flash is whole: its partition is the first.
bool has_good_boot_code(const hxa_flash_attr_t& flash)
{
    constexpr std::uint32_t last_known_status = 5;
    const bool is_there = flash.npart > 0;
    if (is_there && flash.part[0].part_status == 0)
        return true;
    if (is_there && flash.part[0].part_status <= last_known_status)
        ZMLR_LOG(LL_INFO, "Boot code upload status is not GOOD");
    else
        ZMLR_LOG(LL_WARN, "No Flash Status Found");
    return false;
}

void append_bios(Instance_Array& instances, Hba_Reading& adapter)
{
    hxa_flash_attr_t flash = {};
    if (hxal_flash_get_attr(adapter.port.fc.get(), &flash) != HXA_STATUS_OK)
    {
        ZMLR_LOG(LL_ERR, "hxal_ioc_get_attr call failed for Adapter id %d", adapter.port.adapter);
        return;
    }
    fill_boot_code(adapter.info, adapter.fc.value);
    if (has_good_boot_code(flash))
        instances.adopt(getAdapterSoftwareIdentityInstance(adapter.info, SOFTWARE_BIOS, false));
}

void append_software(Instance_Array& instances, Adapter_Reading& reading)
{
    Hba_Reading& adapter = reading.adapter;
    if (reading.wanted.is_all()) // which adapter tells of a driver is known only when none is left out
    {
        append_driver(instances, adapter.info, adapter.ethernet.are_read, true, reading.network_driver_is_told);
        append_driver(instances, adapter.info, adapter.fc.are_read, false, reading.storage_driver_is_told);
    }
    if (adapter.port.fc)
        append_bios(instances, adapter);
    instances.adopt(getAdapterSoftwareIdentityInstance(adapter.info, SOFTWARE_FIRMWARE, false));
}

constexpr Builder<Adapter_Reading> adapter_builders[] = {
    {CLASSID_PortController, append_controller},
    {CLASSID_PhysicalPackage, append_package},
    {CLASSID_Product, append_product},
    {CLASSID_AdapterSoftwareIdentity, append_software},
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
    Adapter_Walk adapters(adapter_walk, &request.wanted);
    if (adapters.count() == 0)
        return instances;

    bool network_driver_is_told = false;
    bool storage_driver_is_told = false;
    while (adapters.next())
    {
        std::optional<Open_Port> port = open_port(adapter_walk, adapters.adapter(), 0, &request.wanted);
        if (!port)
            continue;
        std::optional<Hba_Reading> adapter = read_hba(adapters.adapter(), std::move(*port), request);
        if (!adapter)
            continue;
        Adapter_Reading reading = {*adapter, request.wanted, network_driver_is_told, storage_driver_is_told};
        build(instances, adapter_builders, id, reading, log_source, "Default case . Other classes ");
    }
    ZMLR_LOG(LL_INFO, "Number of instances: %d", static_cast<int>(instances.size()));
    return instances;
}

} // namespace zmlr
