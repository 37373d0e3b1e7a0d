#include "inventory/fchba_manager.h"

#include "inventory/adapter_helper.h"
#include "inventory/common_helper.h"
#include "inventory/dispatch.h"
#include "inventory/port_helper.h"
#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "FCHBAManager";

Instance_Array common(classId_t id) { return CommonHelper::getCommonHelperObject().getComputerSystemInstances(id); }
Instance_Array adapter(classId_t id) { return AdapterHelper::getAdapterHelperInstance().getInstancesByClass(id); }
Instance_Array port(classId_t id) { return PortHelper::getPortHelperObject().getInstancesByClass(id); }

// clang-format off
constexpr Route routes[] = {
    {CLASSID_ComputerSystem,                 CLASSID_ComputerSystem,                             Gate::open,    common},
    {CLASSID_PortController,                 CLASSID_PortController,                             Gate::checked, adapter},
    {CLASSID_FCPort,                         CLASSID_FCPort,                                     Gate::checked, port},
    {CLASSID_SCSIProtocolEndpoint,           CLASSID_AdapterSoftwareIdentity,                    Gate::checked, nullptr},
    {CLASSID_RemoteServiceAccessPoint,       CLASSID_RemoteServiceAccessPoint,                   Gate::open,    nullptr},
    {CLASSID_HBASoftwareInstallationService, CLASSID_HBASoftwareInstallationServiceCapabilities, Gate::checked, nullptr},
    {CLASSID_EthernetPort,                   CLASSID_EthernetPort,                               Gate::checked, nullptr},
    {CLASSID_MemoryDiagnosticTest,           CLASSID_DiagnosticCompletionRecord,                 Gate::checked, nullptr},
    {CLASSID_LogicalPortGroup,               CLASSID_LogicalPortGroup,                           Gate::checked, nullptr},
    {CLASSID_AffectedJobElement,             CLASSID_CompletionRecordAppliesToElement,           Gate::checked, nullptr},
    {CLASSID_LANEndpoint,                    CLASSID_LANEndpoint,                                Gate::checked, nullptr},
    {CLASSID_PhysicalConnector,              CLASSID_PhysicalConnector,                          Gate::checked, nullptr},
    {CLASSID_AlarmDevice,                    CLASSID_AlarmDevice,                                Gate::checked, nullptr},
};
// clang-format on

} // namespace

FCHBAManager::FCHBAManager() { ZMLR_LOG(LL_INFO, "Inside FCHBAManager Constructor"); }

const FCHBAManager& FCHBAManager::getFCHBAManager()
{
    static const FCHBAManager manager;
    return manager;
}

Instance_Array FCHBAManager::getInstances(classId_t id) const { return dispatch(log_source, routes, id); }

Instance_Array FCHBAManager::getFCPortInstancesByAdapter(const String& address) const
{
    const Scope_Trace trace(log_source);
    return PortHelper::getPortHelperObject().getFCPortInstancesByAdapter(address);
}

} // namespace zmlr
