#include "inventory/class_id.h"

#include <iterator>

namespace zmlr
{

namespace
{

constinit Fixed_Text<49> class_names[] = {
    "--",
    "ZEMLAR_ComputerSystem",
    "ZEMLAR_PortController",
    "ZEMLAR_FCPort",
    "ZEMLAR_SCSIProtocolEndpoint",
    "ZEMLAR_FCPortStatistics",
    "ZEMLAR_PhysicalPackage",
    "ZEMLAR_Product",
    "ZEMLAR_AdapterSoftwareIdentity",
    "ZEMLAR_StorageExtent",
    "ZEMLAR_RegisteredProfile",
    "ZEMLAR_RegisteredSubProfile",
    "ZEMLAR_Namespace",
    "ZEMLAR_ObjectManager",
    "ZEMLAR_CIMXMLCommunicationMechanism",
    "ZEMLAR_ProfileSoftwareIdentity",
    "ZEMLAR_TapeDrive",
    "ZEMLAR_RemoteServiceAccessPoint",
    "ZEMLAR_HBASoftwareInstallationService",
    "ZEMLAR_HBASoftwareInstallationServiceCapabilities",
    "ZEMLAR_EthernetPort",
    "ZEMLAR_MemoryDiagnosticTest",
    "ZEMLAR_LoopbackDiagnosticTest",
    "ZEMLAR_PCILoopbackDiagnosticTest",
    "ZEMLAR_EthLoopbackDiagnosticTest",
    "ZEMLAR_DiagnosticSoftwareIdentity",
    "ZEMLAR_ConcreteJob",
    "ZEMLAR_DiagnosticServiceRecord",
    "ZEMLAR_DiagnosticCompletionRecord",
    "ZEMLAR_DiagnosticElementSoftwareIdentity",
    "ZEMLAR_LogicalPortGroup",
    "ZEMLAR_AffectedJobElement",
    "ZEMLAR_ServiceRecordAppliesToElement",
    "ZEMLAR_CompletionRecordAppliesToElement",
    "ZEMLAR_LANEndpoint",
    "ZEMLAR_PhysicalConnector",
    "ZEMLAR_AlarmDevice",
};
static_assert(std::size(class_names) == MAXCLASSID + 1);

} // namespace

String class_name(classId_t id) { return id <= MAXCLASSID ? String(class_names[id]) : String(); }

} // namespace zmlr
