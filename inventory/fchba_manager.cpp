#include "inventory/fchba_manager.h"

#include "inventory/adapter_helper.h"
#include "inventory/common_helper.h"
#include "inventory/dispatch.h"
#include "inventory/ethernet_port_helper.h"
#include "inventory/physical_asset_helper.h"
#include "inventory/port_helper.h"
#include "inventory/served_above.h"
#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "FCHBAManager";

Instance_Array common(classId_t id, const Inventory_Request& request)
{
    return CommonHelper::getCommonHelperObject().getComputerSystemInstances(id, request);
}

Instance_Array adapter(classId_t id, const Inventory_Request& request)
{
    return AdapterHelper::getAdapterHelperInstance().getInstancesByClass(id, request);
}

Instance_Array port(classId_t id, const Inventory_Request& request)
{
    return PortHelper::getPortHelperObject().getInstancesByClass(id, request);
}

Instance_Array ethernet_port(classId_t id, const Inventory_Request& request)
{
    return EthernetPortHelper::getEthernetPortHelperObject().getInstancesByClass(id, request);
}

Instance_Array physical_asset(classId_t id, const Inventory_Request& request)
{
    return PhysicalAssetHelper::getPhysicalAssetHelperObject().getInstancesByClass(id, request);
}

// clang-format off
constexpr Route routes[] = {
    {CLASSID_ComputerSystem,                  CLASSID_ComputerSystem,                              Driver::not_needed, common},
    {CLASSID_PortController,                  CLASSID_PortController,                              Driver::needed,     adapter},
    {CLASSID_FCPort,                          CLASSID_FCPort,                                      Driver::needed,     port},
    {CLASSID_SCSIProtocolEndpoint,            CLASSID_FCPortStatistics,                            Driver::needed,     port},
    {CLASSID_PhysicalPackage,                 CLASSID_AdapterSoftwareIdentity,                     Driver::needed,     adapter},
    {CLASSID_RemoteServiceAccessPoint,        CLASSID_RemoteServiceAccessPoint,                    Driver::not_needed, nullptr},
    {CLASSID_HBASoftwareInstallationService,  CLASSID_HBASoftwareInstallationServiceCapabilities,  Driver::needed,     nullptr},
    {CLASSID_EthernetPort,                    CLASSID_EthernetPort,                                Driver::needed,     ethernet_port},
    {CLASSID_MemoryDiagnosticTest,            CLASSID_DiagnosticCompletionRecord,                  Driver::needed,     diagnostic_instances},
    {CLASSID_LogicalPortGroup,                CLASSID_LogicalPortGroup,                            Driver::needed,     port},
    {CLASSID_AffectedJobElement,              CLASSID_CompletionRecordAppliesToElement,            Driver::needed,     diagnostic_instances},
    {CLASSID_LANEndpoint,                     CLASSID_LANEndpoint,                                 Driver::needed,     ethernet_port},
    {CLASSID_PhysicalConnector,               CLASSID_PhysicalConnector,                           Driver::needed,     physical_asset},
    {CLASSID_AlarmDevice,                     CLASSID_AlarmDevice,                                 Driver::needed,     port},
};
// clang-format on

} // namespace

FCHBAManager::FCHBAManager() { ZMLR_LOG(LL_INFO, "Inside FCHBAManager Constructor"); }

const FCHBAManager& FCHBAManager::getFCHBAManager()
{
    static const FCHBAManager manager;
    return manager;
}

Instance_Array FCHBAManager::getInstances(classId_t id, const Inventory_Request& request) const
{
    return dispatch(log_source, routes, id, request);
}

Instance_Array FCHBAManager::getFCPortInstancesByAdapter(const String& address, const Inventory_Request& request) const
{
    const Scope_Trace trace(log_source);
    return PortHelper::getPortHelperObject().getFCPortInstancesByAdapter(address, request);
}

Instance_Array FCHBAManager::getEthernetPortInstancesByAdapter(const String& mac, const Inventory_Request& request) const
{
    const Scope_Trace trace(log_source);
    return EthernetPortHelper::getEthernetPortHelperObject().getEthernetPortInstancesByAdapter(mac, request);
}

} // namespace zmlr
