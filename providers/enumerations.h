// The providers that only enumerate: whom each asks for which instances, and what it logs when none came.
#pragma once

#include "providers/enumeration.h"
#include "schema/ZEMLAR_AdapterSoftwareIdentity.h"
#include "schema/ZEMLAR_AffectedJobElement.h"
#include "schema/ZEMLAR_AlarmDevice.h"
#include "schema/ZEMLAR_CIMXMLCommunicationMechanism.h"
#include "schema/ZEMLAR_CompletionRecordAppliesToElement.h"
#include "schema/ZEMLAR_ComputerSystem.h"
#include "schema/ZEMLAR_ConcreteJob.h"
#include "schema/ZEMLAR_DiagnosticCompletionRecord.h"
#include "schema/ZEMLAR_DiagnosticServiceRecord.h"
#include "schema/ZEMLAR_DiagnosticSoftwareIdentity.h"
#include "schema/ZEMLAR_EthLoopbackDiagnosticTest.h"
#include "schema/ZEMLAR_EthernetPort.h"
#include "schema/ZEMLAR_FCPort.h"
#include "schema/ZEMLAR_FCPortStatistics.h"
#include "schema/ZEMLAR_HBASoftwareInstallationService.h"
#include "schema/ZEMLAR_HBASoftwareInstallationServiceCapabilities.h"
#include "schema/ZEMLAR_LANEndpoint.h"
#include "schema/ZEMLAR_LogicalPortGroup.h"
#include "schema/ZEMLAR_LoopbackDiagnosticTest.h"
#include "schema/ZEMLAR_MemoryDiagnosticTest.h"
#include "schema/ZEMLAR_Namespace.h"
#include "schema/ZEMLAR_ObjectManager.h"
#include "schema/ZEMLAR_PCILoopbackDiagnosticTest.h"
#include "schema/ZEMLAR_PhysicalConnector.h"
#include "schema/ZEMLAR_PhysicalPackage.h"
#include "schema/ZEMLAR_PortController.h"
#include "schema/ZEMLAR_Product.h"
#include "schema/ZEMLAR_ProfileSoftwareIdentity.h"
#include "schema/ZEMLAR_RegisteredProfile.h"
#include "schema/ZEMLAR_RegisteredSubProfile.h"
#include "schema/ZEMLAR_RemoteServiceAccessPoint.h"
#include "schema/ZEMLAR_SCSIProtocolEndpoint.h"
#include "schema/ZEMLAR_ServiceRecordAppliesToElement.h"
#include "schema/ZEMLAR_StorageExtent.h"
#include "schema/ZEMLAR_TapeDrive.h"

namespace zmlr
{

template <class T> inline constexpr const Meta_Class* of = &T::static_meta_class;

// clang-format off
inline constexpr Enumeration enumerations[] = {
    {of<ZEMLAR_ComputerSystem>,           fchba_manager, CLASSID_ComputerSystem,           {{LL_ERR, "Error: Invalid mapping information"}}},
    {of<ZEMLAR_PortController>,           fchba_manager, CLASSID_PortController,           {{LL_ERR, "No Adapter Found!"}}},
    {of<ZEMLAR_FCPort>,                   fchba_manager, CLASSID_FCPort,                   {{LL_ERR, "No FC Ports Found!"}}},
    {of<ZEMLAR_FCPortStatistics>,         fchba_manager, CLASSID_FCPortStatistics,         {{LL_ERR, "No FC Ports Found!"}}},
    {of<ZEMLAR_AdapterSoftwareIdentity>,  fchba_manager, CLASSID_AdapterSoftwareIdentity,  {{LL_ERR, "No Adapter Found!"}}},
    {of<ZEMLAR_PhysicalPackage>,          fchba_manager, CLASSID_PhysicalPackage,          {{LL_ERR, "No Adapter Found!"}}},
    {of<ZEMLAR_Product>,                  fchba_manager, CLASSID_Product,                  {{LL_ERR, "No Adapter Found!"}}},
    {of<ZEMLAR_SCSIProtocolEndpoint>,     fchba_manager, CLASSID_SCSIProtocolEndpoint,     {{LL_ERR, "No FC Ports Found!"}}},
    {of<ZEMLAR_ObjectManager>,                 server_manager, CLASSID_ObjectManager,                {}},
    {of<ZEMLAR_Namespace>,                     server_manager, CLASSID_Namespace,                    {}},
    {of<ZEMLAR_CIMXMLCommunicationMechanism>,  server_manager, CLASSID_CIMXMLCommunicationMechanism, {}},
    {of<ZEMLAR_RegisteredProfile>,             server_manager, CLASSID_RegisteredProfile,            {}},
    {of<ZEMLAR_RegisteredSubProfile>,          server_manager, CLASSID_RegisteredSubProfile,         {}},
    {of<ZEMLAR_ProfileSoftwareIdentity>,       server_manager, CLASSID_ProfileSoftwareIdentity,      {{LL_ERR, "Error: Invalid number of ProfileSoftwareIdentityInstances"}}},
    {of<ZEMLAR_StorageExtent>,            hdr_manager,   CLASSID_StorageExtent,            {{LL_ERR, "No StorageExtents Found!"}}},
    {of<ZEMLAR_TapeDrive>,                hdr_manager,   CLASSID_TapeDrive,                {{LL_ERR, "No TapeDrives Found!"}}},
    {of<ZEMLAR_RemoteServiceAccessPoint>, fchba_manager, CLASSID_RemoteServiceAccessPoint, {{LL_ERR, "Error: Invalid mapping information"}, {LL_ERR, "Warning: No service is available"}}},
    {of<ZEMLAR_HBASoftwareInstallationService>, fchba_manager, CLASSID_HBASoftwareInstallationService, {{LL_ERR, "Error: Invalid mapping information"}}},
    {of<ZEMLAR_HBASoftwareInstallationServiceCapabilities>, fchba_manager, CLASSID_HBASoftwareInstallationServiceCapabilities, {{LL_ERR, "Error: Invalid mapping information"}}},
    {of<ZEMLAR_EthernetPort>,             fchba_manager, CLASSID_EthernetPort,             {{LL_ERR, "Error: Invalid mapping information"}}},
    {of<ZEMLAR_MemoryDiagnosticTest>, fchba_manager, CLASSID_MemoryDiagnosticTest, {{LL_ERR, "No memory diagnostic test is available"}}},
    {of<ZEMLAR_LoopbackDiagnosticTest>, fchba_manager, CLASSID_LoopbackDiagnosticTest, {{LL_ERR, "No loopback diagnostic test is available"}}},
    {of<ZEMLAR_PCILoopbackDiagnosticTest>, fchba_manager, CLASSID_PCILoopbackDiagnosticTest, {{LL_ERR, "No PCI loopback diagnostic test is available"}}},
    {of<ZEMLAR_EthLoopbackDiagnosticTest>, fchba_manager, CLASSID_EthLoopbackDiagnosticTest, {{LL_ERR, "No ethloopback diagnostic test is available"}}},
    {of<ZEMLAR_DiagnosticSoftwareIdentity>, fchba_manager, CLASSID_DiagnosticSoftwareIdentity, {{LL_ERR, "No diagnostic software is installed"}}},
    {of<ZEMLAR_ConcreteJob>, fchba_manager, CLASSID_ConcreteJob, {{LL_INFO, "No jobs are currently running in the system."}}},
    {of<ZEMLAR_DiagnosticServiceRecord>, fchba_manager, CLASSID_DiagnosticServiceRecord, {{LL_ERR, "No diagnostic service records are available."}}},
    {of<ZEMLAR_DiagnosticCompletionRecord>, fchba_manager, CLASSID_DiagnosticCompletionRecord, {{LL_INFO, "No completion records are available."}}},
    {of<ZEMLAR_AffectedJobElement>, fchba_manager, CLASSID_AffectedJobElement, {{LL_ERR, "Any affectedJobElement association could not be formed."}}},
    {of<ZEMLAR_ServiceRecordAppliesToElement>, fchba_manager, CLASSID_ServiceRecordAppliesToElement, {{LL_ERR, "No service records or managed elements are present."}}},
    {of<ZEMLAR_CompletionRecordAppliesToElement>, fchba_manager, CLASSID_CompletionRecordAppliesToElement, {{LL_ERR, "No completion records or managed elements are present."}}},
    {of<ZEMLAR_LogicalPortGroup>,         fchba_manager, CLASSID_LogicalPortGroup,         {{LL_ERR, "No Logical Port Groups found!"}}},
    {of<ZEMLAR_PhysicalConnector>,        fchba_manager, CLASSID_PhysicalConnector,        {{LL_ERR, "No Connector Found!"}}},
    {of<ZEMLAR_LANEndpoint>,              fchba_manager, CLASSID_LANEndpoint,              {{LL_ERR, "No Ethernet Port Found"}}},
    {of<ZEMLAR_AlarmDevice>,              fchba_manager, CLASSID_AlarmDevice,              {{LL_ERR, "Invalid number of Instances returned"}}},
};
// clang-format on

} // namespace zmlr
