// Class identifiers: the number by which providers ask the managers for the instances of one class, and its name.
#pragma once

#include "runtime/string.h"
#include "runtime/types.h"

namespace zmlr
{

// clang-format off
enum classId_t : uint32
{
    CLASSID_None                                       =  0,
    CLASSID_ComputerSystem                             =  1,
    CLASSID_PortController                             =  2,
    CLASSID_FCPort                                     =  3,
    CLASSID_SCSIProtocolEndpoint                       =  4,
    CLASSID_FCPortStatistics                           =  5,
    CLASSID_PhysicalPackage                            =  6,
    CLASSID_Product                                    =  7,
    CLASSID_AdapterSoftwareIdentity                    =  8,
    CLASSID_StorageExtent                              =  9,
    CLASSID_RegisteredProfile                          = 10,
    CLASSID_RegisteredSubProfile                       = 11,
    CLASSID_Namespace                                  = 12,
    CLASSID_ObjectManager                              = 13,
    CLASSID_CIMXMLCommunicationMechanism               = 14,
    CLASSID_ProfileSoftwareIdentity                    = 15,
    CLASSID_TapeDrive                                  = 16,
    CLASSID_RemoteServiceAccessPoint                   = 17,
    CLASSID_HBASoftwareInstallationService             = 18,
    CLASSID_HBASoftwareInstallationServiceCapabilities = 19,
    CLASSID_EthernetPort                               = 20,
    CLASSID_MemoryDiagnosticTest                       = 21,
    CLASSID_LoopbackDiagnosticTest                     = 22,
    CLASSID_PCILoopbackDiagnosticTest                  = 23,
    CLASSID_EthLoopbackDiagnosticTest                  = 24,
    CLASSID_DiagnosticSoftwareIdentity                 = 25,
    CLASSID_ConcreteJob                                = 26,
    CLASSID_DiagnosticServiceRecord                    = 27,
    CLASSID_DiagnosticCompletionRecord                 = 28,
    CLASSID_DiagnosticElementSoftwareIdentity          = 29,
    CLASSID_LogicalPortGroup                           = 30,
    CLASSID_AffectedJobElement                         = 31,
    CLASSID_ServiceRecordAppliesToElement              = 32,
    CLASSID_CompletionRecordAppliesToElement           = 33,
    CLASSID_LANEndpoint                                = 34,
    CLASSID_PhysicalConnector                          = 35,
    CLASSID_AlarmDevice                                = 36,
};
// clang-format on

inline constexpr uint32 MAXCLASSID = 36;

// The class's name, "--" for CLASSID_None, empty above MAXCLASSID. It takes no memory.
String class_name(classId_t id);

} // namespace zmlr
