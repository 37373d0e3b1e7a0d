#include "inventory/port_controller.h"

#include "inventory/cim_values.h"
#include "inventory/property_text.h"
#include "inventory/provider_util.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "AdapterHelper";

} // namespace

Ref<ZEMLAR_PortController> getPortControllerInstance(const _hbaInfo& info)
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
    controller->Caption.set(info.display_name());
    controller->Description.set(info.display_name());
    controller->OperationalStatus.set({static_cast<uint16>(info.adapter_state)});
    controller->StatusDescriptions.set({in_service ? "The adapter is in service" : "The adapter is disabled"});
    controller->EnabledState.set(in_service ? ENABLED_STATE_ENABLED : ENABLED_STATE_DISABLED);
    controller->ControllerType.set(info.is_cna ? CONTROLLER_TYPE_OTHER : CONTROLLER_TYPE_FC);
    if (info.is_cna)
        controller->OtherControllerType.set("CNA - FC and Ethernet types");
    return controller;
}

} // namespace zmlr
