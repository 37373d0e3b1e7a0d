#include "inventory/fchba_manager.h"

#include "inventory/access_point_helper.h"
#include "inventory/adapter_helper.h"
#include "inventory/common_helper.h"
#include "inventory/dispatch.h"
#include "inventory/ethernet_port_helper.h"
#include "inventory/physical_asset_helper.h"
#include "inventory/port_helper.h"
#include "inventory/served_above.h"
#include "inventory/software_update_helper.h"
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

template <auto helper> Instance_Array by_class(classId_t id, const Inventory_Request& request)
{
    return helper().getInstancesByClass(id, request);
}

constexpr auto access_point = by_class<AccessPointHelper::getAccessPointHelperInstance>;
constexpr auto adapter = by_class<AdapterHelper::getAdapterHelperInstance>;
constexpr auto ethernet_port = by_class<EthernetPortHelper::getEthernetPortHelperObject>;
constexpr auto physical_asset = by_class<PhysicalAssetHelper::getPhysicalAssetHelperObject>;
constexpr auto port = by_class<PortHelper::getPortHelperObject>;
constexpr auto software_update = by_class<SoftwareUpdateHelper::getSoftwareUpdateHelperInstance>;

// clang-format off
constexpr Route routes[] = {
    {CLASSID_ComputerSystem,                  CLASSID_ComputerSystem,                              Driver::not_needed, common},
    {CLASSID_PortController,                  CLASSID_PortController,                              Driver::needed,     adapter},
    {CLASSID_FCPort,                          CLASSID_FCPort,                                      Driver::needed,     port},
    {CLASSID_SCSIProtocolEndpoint,            CLASSID_FCPortStatistics,                            Driver::needed,     port},
    {CLASSID_PhysicalPackage,                 CLASSID_AdapterSoftwareIdentity,                     Driver::needed,     adapter},
    {CLASSID_RemoteServiceAccessPoint,        CLASSID_RemoteServiceAccessPoint,                    Driver::not_needed, access_point},
    {CLASSID_HBASoftwareInstallationService,  CLASSID_HBASoftwareInstallationServiceCapabilities,  Driver::needed,     software_update},
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

Instance_Array FCHBAManager::getAllDiagnosticTestInstances(const Inventory_Request& request) const
{
    const Scope_Trace trace(log_source);
    return diagnostic_services(request);
}

Instance_Array FCHBAManager::getDiagnosticServicesForAdapter(const Inventory_Request& request) const
{
    const Scope_Trace trace(log_source);
    return getInstances(CLASSID_MemoryDiagnosticTest, request);
}

Instance_Array FCHBAManager::getDiagnosticServicesForFCPort(const Inventory_Request& request) const
{
    const Scope_Trace trace(log_source);
    Instance_Array tests = getInstances(CLASSID_LoopbackDiagnosticTest, request);
    tests.adopt(getInstances(CLASSID_PCILoopbackDiagnosticTest, request));
    return tests;
}

Instance_Array FCHBAManager::getDiagnosticServicesForEthernetPort(const Inventory_Request& request) const
{
    const Scope_Trace trace(log_source);
    Instance_Array tests = getInstances(CLASSID_EthLoopbackDiagnosticTest, request);
    tests.adopt(getInstances(CLASSID_PCILoopbackDiagnosticTest, request));
    return tests;
}

} // namespace zmlr
