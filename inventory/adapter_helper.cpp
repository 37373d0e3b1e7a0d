#include "inventory/adapter_helper.h"

#include "inventory/cim_values.h"
#include "inventory/property_text.h"
#include "inventory/provider_util.h"
#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "AdapterHelper";

const char* display_name(const _hbaInfo& info) { return info.is_cna ? "Zemlar CNA" : "Zemlar FC HBA"; }

sint32 adapter_state(int index)
{
    return hxal_adapter_is_disabled(index) ? OPERATIONAL_STATUS_STOPPED : OPERATIONAL_STATUS_IN_SERVICE;
}

void append(Instance_Array& instances, classId_t id, int index, _hbaInfo& info)
{
    switch (id)
    {
    case CLASSID_PortController:
        info.adapter_state = adapter_state(index);
        instances.adopt(Ref<Instance>(AdapterHelper::getPortControllerInstance(info).steal()));
        break;
    default:
        ZMLR_LOG(LL_INFO, "Default case . Other classes ");
    }
}

} // namespace

const AdapterHelper& AdapterHelper::getAdapterHelperInstance()
{
    static constinit const AdapterHelper helper;
    return helper;
}

Instance_Array AdapterHelper::getInstancesByClass(classId_t id) const
{
    const Scope_Trace trace(log_source);
    Instance_Array instances;
    const int adapters = static_cast<int>(hxal_adapter_get_num());
    ZMLR_LOG(LL_INFO, "Number of Adapters: %d", adapters);
    if (adapters == 0)
    {
        ZMLR_LOG(LL_INFO, "No adapters in the system!");
        return instances;
    }

    char host[sizeof(_hbaInfo::host)] = {};
    ProviderUtil::getHostInfo(host, sizeof host - 1);
    for (int index = 1; index <= adapters; index++)
    {
        std::optional<_hbaInfo> info = read_hba_info(index);
        if (!info)
            continue;
        copy_text(info->host, host);
        append(instances, id, index, *info);
    }
    ZMLR_LOG(LL_INFO, "Number of instances: %d", static_cast<int>(instances.size()));
    return instances;
}

Ref<ZEMLAR_PortController> AdapterHelper::getPortControllerInstance(const _hbaInfo& info)
{
    const Scope_Trace trace(log_source);
    const bool in_service = info.adapter_state == OPERATIONAL_STATUS_IN_SERVICE;
    const String serial_number = property_text(info.serial_number);

    Ref<ZEMLAR_PortController> controller(ZEMLAR_PortController::create());
    controller->CreationClassName.set(ProviderUtil::getClassName(CLASSID_PortController));
    controller->SystemCreationClassName.set(ProviderUtil::getClassName(CLASSID_ComputerSystem));
    controller->SystemName.set(property_text(info.host));
    controller->DeviceID.set(info.address());
    controller->Name.set(serial_number);
    controller->ElementName.set(serial_number);
    controller->Caption.set(display_name(info));
    controller->Description.set(display_name(info));
    controller->OperationalStatus.set({static_cast<uint16>(info.adapter_state)});
    controller->StatusDescriptions.set({in_service ? "The adapter is in service" : "The adapter is disabled"});
    controller->EnabledState.set(in_service ? ENABLED_STATE_ENABLED : ENABLED_STATE_DISABLED);
    controller->ControllerType.set(info.is_cna ? CONTROLLER_TYPE_OTHER : CONTROLLER_TYPE_FC);
    if (info.is_cna)
        controller->OtherControllerType.set("CNA - FC and Ethernet types");
    return controller;
}

} // namespace zmlr
