// The served classes as clients know them: superclass, key order, and the class at the end of each reference.
#include "runtime/instance.h"
#include "runtime/string.h"
#include "schema/repository.h"

#include <gtest/gtest.h>

#include <map>
#include <sstream>
#include <string>

namespace zmlr
{
namespace
{

struct Served_Class
{
    const char* name;
    const char* superclass;
    const char* keys; // in order; "name>class" for a reference
};

constexpr const char* device_keys = "SystemCreationClassName SystemName CreationClassName DeviceID";
constexpr const char* service_keys = "Name SystemCreationClassName SystemName CreationClassName";

// clang-format off
constexpr Served_Class catalogue[] = {
    {"ZEMLAR_ComputerSystem",          "CIM_ComputerSystem",          "Name CreationClassName"},
    {"ZEMLAR_PortController",          "CIM_PortController",          device_keys},
    {"ZEMLAR_PhysicalPackage",         "CIM_PhysicalPackage",         "Tag CreationClassName"},
    {"ZEMLAR_Product",                 "CIM_Product",                 "Name IdentifyingNumber Vendor Version"},
    {"ZEMLAR_AdapterSoftwareIdentity", "CIM_SoftwareIdentity",        "InstanceID"},
    {"ZEMLAR_FCPort",                  "CIM_FCPort",                  device_keys},
    {"ZEMLAR_SCSIProtocolEndpoint",    "CIM_SCSIProtocolEndpoint",    service_keys},
    {"ZEMLAR_FCPortStatistics",        "CIM_FCPortStatistics",        "InstanceID"},
    {"ZEMLAR_LogicalPortGroup",        "CIM_LogicalPortGroup",        "InstanceID"},
    {"ZEMLAR_AlarmDevice",             "CIM_AlarmDevice",             device_keys},
    {"ZEMLAR_StorageExtent",           "CIM_StorageExtent",           device_keys},
    {"ZEMLAR_TapeDrive",               "CIM_TapeDrive",               device_keys},
    {"ZEMLAR_LogicalDisk",             "CIM_LogicalDisk",             device_keys},
    {"ZEMLAR_EthernetPort",            "CIM_EthernetPort",            device_keys},
    {"ZEMLAR_LANEndpoint",             "CIM_LANEndpoint",             service_keys},
    {"ZEMLAR_PhysicalConnector",       "CIM_PhysicalConnector",       "Tag CreationClassName"},
    {"ZEMLAR_RemoteServiceAccessPoint", "CIM_RemoteServiceAccessPoint", service_keys},
    {"ZEMLAR_HBASoftwareInstallationService", "CIM_SoftwareInstallationService", service_keys},
    {"ZEMLAR_HBASoftwareInstallationServiceCapabilities", "CIM_SoftwareInstallationServiceCapabilities", "InstanceID"},

    {"ZEMLAR_RegisteredProfile",          "CIM_RegisteredProfile",          "InstanceID"},
    {"ZEMLAR_RegisteredSubProfile",       "CIM_RegisteredSubProfile",       "InstanceID"},
    {"ZEMLAR_ObjectManager",              "CIM_ObjectManager",              service_keys},
    {"ZEMLAR_Namespace",                  "CIM_Namespace",
        "SystemCreationClassName SystemName ObjectManagerCreationClassName ObjectManagerName CreationClassName Name"},
    {"ZEMLAR_CIMXMLCommunicationMechanism", "CIM_CIMXMLCommunicationMechanism", service_keys},
    {"ZEMLAR_ProfileSoftwareIdentity",    "CIM_SoftwareIdentity",           "InstanceID"},

    {"ZEMLAR_DiagnosticTest",             "CIM_DiagnosticTest",             service_keys},
    {"ZEMLAR_MemoryDiagnosticTest",       "ZEMLAR_DiagnosticTest",          service_keys},
    {"ZEMLAR_LoopbackDiagnosticTest",     "ZEMLAR_DiagnosticTest",          service_keys},
    {"ZEMLAR_PCILoopbackDiagnosticTest",  "ZEMLAR_DiagnosticTest",          service_keys},
    {"ZEMLAR_EthLoopbackDiagnosticTest",  "ZEMLAR_DiagnosticTest",          service_keys},
    {"ZEMLAR_DiagnosticSoftwareIdentity", "CIM_SoftwareIdentity",           "InstanceID"},
    {"ZEMLAR_ConcreteJob",                "CIM_ConcreteJob",                "InstanceID"},
    {"ZEMLAR_DiagnosticServiceRecord",    "CIM_DiagnosticServiceRecord",    "InstanceID"},
    {"ZEMLAR_DiagnosticCompletionRecord", "CIM_DiagnosticCompletionRecord", "InstanceID"},
    {"ZEMLAR_AlertIndication",            "CIM_AlertIndication",            ""},

    {"ZEMLAR_FCPortSystemDevice",           "CIM_SystemDevice",  "GroupComponent>ZEMLAR_ComputerSystem PartComponent>ZEMLAR_FCPort"},
    {"ZEMLAR_EthernetPortSystemDevice",     "CIM_SystemDevice",  "GroupComponent>ZEMLAR_ComputerSystem PartComponent>ZEMLAR_EthernetPort"},
    {"ZEMLAR_PortControllerSystemDevice",   "CIM_SystemDevice",  "GroupComponent>ZEMLAR_ComputerSystem PartComponent>ZEMLAR_PortController"},
    {"ZEMLAR_StorageResourcesSystemDevice", "CIM_SystemDevice",  "GroupComponent>ZEMLAR_ComputerSystem PartComponent>CIM_LogicalDevice"},
    {"ZEMLAR_HostedAccessPoint",   "CIM_HostedAccessPoint", "Antecedent>ZEMLAR_ComputerSystem Dependent>ZEMLAR_SCSIProtocolEndpoint"},
    {"ZEMLAR_HostedLANEndpoint",   "CIM_HostedAccessPoint", "Antecedent>ZEMLAR_ComputerSystem Dependent>ZEMLAR_LANEndpoint"},
    {"ZEMLAR_HostedCollection",    "CIM_HostedCollection",  "Antecedent>ZEMLAR_ComputerSystem Dependent>ZEMLAR_LogicalPortGroup"},
    {"ZEMLAR_InstalledSoftwareIdentity", "CIM_InstalledSoftwareIdentity",
        "System>ZEMLAR_ComputerSystem InstalledSoftware>ZEMLAR_AdapterSoftwareIdentity"},
    {"ZEMLAR_HBASoftwareInstallationServiceHostedService", "CIM_HostedService",
        "Antecedent>ZEMLAR_ComputerSystem Dependent>ZEMLAR_HBASoftwareInstallationService"},
    {"ZEMLAR_HBASoftwareInstallationServiceElementCapabilities", "CIM_ElementCapabilities",
        "ManagedElement>ZEMLAR_HBASoftwareInstallationService Capabilities>ZEMLAR_HBASoftwareInstallationServiceCapabilities"},
    {"ZEMLAR_RemoteServiceHostedAccessPoint", "CIM_HostedAccessPoint",
        "Antecedent>ZEMLAR_ComputerSystem Dependent>ZEMLAR_RemoteServiceAccessPoint"},
    {"ZEMLAR_ControlledBy",             "CIM_ControlledBy",     "Antecedent>ZEMLAR_PortController Dependent>ZEMLAR_FCPort"},
    {"ZEMLAR_EthernetPortControlledBy", "CIM_ControlledBy",     "Antecedent>ZEMLAR_PortController Dependent>ZEMLAR_EthernetPort"},
    {"ZEMLAR_AdapterElementSoftwareIdentity", "CIM_ElementSoftwareIdentity",
        "Antecedent>ZEMLAR_AdapterSoftwareIdentity Dependent>ZEMLAR_PortController"},
    {"ZEMLAR_ProductElementComponent",  "CIM_ProductElementComponent",  "GroupComponent>ZEMLAR_Product PartComponent>ZEMLAR_PortController"},
    {"ZEMLAR_ProductPhysicalComponent", "CIM_ProductPhysicalComponent", "GroupComponent>ZEMLAR_Product PartComponent>ZEMLAR_PhysicalPackage"},
    {"ZEMLAR_Realizes",                 "CIM_Realizes",         "Antecedent>ZEMLAR_PhysicalPackage Dependent>ZEMLAR_PortController"},
    {"ZEMLAR_PhysicalConnectorContainer", "CIM_Container",      "GroupComponent>ZEMLAR_PhysicalPackage PartComponent>ZEMLAR_PhysicalConnector"},
    {"ZEMLAR_EthernetPortRealizes",     "CIM_Realizes",         "Antecedent>ZEMLAR_PhysicalConnector Dependent>ZEMLAR_EthernetPort"},
    {"ZEMLAR_HostedDependency",         "CIM_HostedDependency", "Antecedent>ZEMLAR_EthernetPort Dependent>ZEMLAR_FCPort"},
    {"ZEMLAR_ElementStatisticalData",   "CIM_ElementStatisticalData", "ManagedElement>ZEMLAR_FCPort Stats>ZEMLAR_FCPortStatistics"},
    {"ZEMLAR_AssociatedAlarm",          "CIM_AssociatedAlarm",  "Antecedent>ZEMLAR_AlarmDevice Dependent>ZEMLAR_FCPort"},
    {"ZEMLAR_DeviceSAPImplementation",  "CIM_DeviceSAPImplementation", "Antecedent>ZEMLAR_FCPort Dependent>ZEMLAR_SCSIProtocolEndpoint"},
    {"ZEMLAR_LANEndpointDeviceSAPImplementation", "CIM_DeviceSAPImplementation", "Antecedent>ZEMLAR_EthernetPort Dependent>ZEMLAR_LANEndpoint"},
    {"ZEMLAR_MemberOfCollection",       "CIM_MemberOfCollection", "Collection>ZEMLAR_LogicalPortGroup Member>ZEMLAR_FCPort"},
    {"ZEMLAR_SCSIInitiatorTargetLogicalUnitPath", "CIM_SCSIInitiatorTargetLogicalUnitPath",
        "Initiator>ZEMLAR_SCSIProtocolEndpoint Target>ZEMLAR_SCSIProtocolEndpoint LogicalUnit>CIM_LogicalDevice"},

    {"ZEMLAR_ElementConformsToProfile",  "CIM_ElementConformsToProfile",  "ConformantStandard>CIM_RegisteredProfile ManagedElement>CIM_ManagedElement"},
    {"ZEMLAR_SubProfileRequiresProfile", "CIM_SubProfileRequiresProfile", "Antecedent>CIM_RegisteredProfile Dependent>CIM_RegisteredSubProfile"},
    {"ZEMLAR_ProfileElementSoftwareIdentity", "CIM_ElementSoftwareIdentity", "Antecedent>CIM_SoftwareIdentity Dependent>CIM_ManagedElement"},
    {"ZEMLAR_NamespaceInManager",        "CIM_NamespaceInManager",        "Antecedent>ZEMLAR_ObjectManager Dependent>ZEMLAR_Namespace"},
    {"ZEMLAR_CommMechanismForManager",   "CIM_CommMechanismForManager",   "Antecedent>ZEMLAR_ObjectManager Dependent>ZEMLAR_CIMXMLCommunicationMechanism"},
    {"ZEMLAR_CommMechHostedAccessPoint", "CIM_HostedAccessPoint",         "Antecedent>ZEMLAR_ComputerSystem Dependent>ZEMLAR_CIMXMLCommunicationMechanism"},
    {"ZEMLAR_ObjectManagerHostedService", "CIM_HostedService",            "Antecedent>ZEMLAR_ComputerSystem Dependent>ZEMLAR_ObjectManager"},

    {"ZEMLAR_AvailableDiagnosticServiceForAdapter",      "CIM_AvailableDiagnosticService", "ServiceProvided>ZEMLAR_DiagnosticTest UserOfService>ZEMLAR_PortController"},
    {"ZEMLAR_AvailableDiagnosticServiceForFCPort",       "CIM_AvailableDiagnosticService", "ServiceProvided>ZEMLAR_DiagnosticTest UserOfService>ZEMLAR_FCPort"},
    {"ZEMLAR_AvailableDiagnosticServiceForEthernetPort", "CIM_AvailableDiagnosticService", "ServiceProvided>ZEMLAR_DiagnosticTest UserOfService>ZEMLAR_EthernetPort"},
    {"ZEMLAR_DiagnosticElementSoftwareIdentity", "CIM_ElementSoftwareIdentity", "Antecedent>ZEMLAR_DiagnosticSoftwareIdentity Dependent>ZEMLAR_DiagnosticTest"},
    {"ZEMLAR_OwningJobElement",               "CIM_OwningJobElement",       "OwningElement>ZEMLAR_DiagnosticTest OwnedElement>ZEMLAR_ConcreteJob"},
    {"ZEMLAR_AffectedJobElement",             "CIM_AffectedJobElement",     "AffectedElement>CIM_ManagedElement AffectingElement>CIM_Job"},
    {"ZEMLAR_ServiceRecordAppliesToElement",  "CIM_RecordAppliesToElement", "Antecedent>CIM_RecordForLog Dependent>CIM_ManagedElement"},
    {"ZEMLAR_CompletionRecordAppliesToElement", "CIM_RecordAppliesToElement", "Antecedent>CIM_RecordForLog Dependent>CIM_ManagedElement"},
};
// clang-format on

// The standard classes between a served class and the root of its chain.
struct Subclasses
{
    const char* superclass; // "": the roots
    const char* names;
};

// clang-format off
constexpr Subclasses tree[] = {
    {"", "CIM_ManagedElement CIM_AbstractComponent CIM_MemberOfCollection CIM_Dependency CIM_AbstractElementStatisticalData "
         "CIM_ElementCapabilities CIM_ElementConformsToProfile CIM_InstalledSoftwareIdentity CIM_InitiatorTargetLogicalUnitPath "
         "CIM_ServiceAvailableToElement CIM_AffectedJobElement CIM_OwningJobElement CIM_Indication"},

    {"CIM_ManagedElement",          "CIM_ManagedSystemElement CIM_Collection CIM_Capabilities CIM_StatisticalData CIM_Product "
                                    "CIM_Namespace CIM_RegisteredSpecification CIM_RecordForLog"},
    {"CIM_ManagedSystemElement",    "CIM_LogicalElement CIM_PhysicalElement"},
    {"CIM_LogicalElement",          "CIM_Job CIM_EnabledLogicalElement CIM_SoftwareIdentity"},
    {"CIM_Job",                     "CIM_ConcreteJob"},
    {"CIM_EnabledLogicalElement",   "CIM_AllocatedLogicalElement CIM_ServiceAccessPoint CIM_Service"},
    {"CIM_AllocatedLogicalElement", "CIM_System CIM_LogicalDevice"},
    {"CIM_System",                  "CIM_ComputerSystem"},
    {"CIM_LogicalDevice",           "CIM_AlarmDevice CIM_Controller CIM_LogicalPort CIM_StorageExtent CIM_MediaAccessDevice"},
    {"CIM_Controller",              "CIM_PortController"},
    {"CIM_LogicalPort",             "CIM_NetworkPort"},
    {"CIM_NetworkPort",             "CIM_EthernetPort CIM_FCPort"},
    {"CIM_StorageExtent",           "CIM_LogicalDisk"},
    {"CIM_MediaAccessDevice",       "CIM_TapeDrive"},
    {"CIM_ServiceAccessPoint",      "CIM_ProtocolEndpoint CIM_RemoteServiceAccessPoint CIM_ObjectManagerCommunicationMechanism"},
    {"CIM_ProtocolEndpoint",        "CIM_LANEndpoint CIM_SCSIProtocolEndpoint"},
    {"CIM_ObjectManagerCommunicationMechanism", "CIM_CIMXMLCommunicationMechanism"},
    {"CIM_Service",                 "CIM_SoftwareInstallationService CIM_WBEMService CIM_DiagnosticService"},
    {"CIM_WBEMService",             "CIM_ObjectManager"},
    {"CIM_DiagnosticService",       "CIM_DiagnosticTest"},
    {"CIM_PhysicalElement",         "CIM_PhysicalPackage CIM_PhysicalConnector"},
    {"CIM_Collection",              "CIM_SystemSpecificCollection"},
    {"CIM_SystemSpecificCollection", "CIM_LogicalPortGroup"},
    {"CIM_Capabilities",            "CIM_SoftwareInstallationServiceCapabilities"},
    {"CIM_StatisticalData",         "CIM_NetworkPortStatistics"},
    {"CIM_NetworkPortStatistics",   "CIM_FCPortStatistics"},
    {"CIM_RegisteredSpecification", "CIM_RegisteredProfile"},
    {"CIM_RegisteredProfile",       "CIM_RegisteredSubProfile"},
    {"CIM_RecordForLog",            "CIM_DiagnosticRecord"},
    {"CIM_DiagnosticRecord",        "CIM_DiagnosticServiceRecord"},
    {"CIM_DiagnosticServiceRecord", "CIM_DiagnosticCompletionRecord"},

    {"CIM_Indication",              "CIM_ProcessIndication"},
    {"CIM_ProcessIndication",       "CIM_AlertIndication"},

    {"CIM_AbstractComponent",       "CIM_Component"},
    {"CIM_Component",               "CIM_SystemComponent CIM_Container CIM_ProductElementComponent"},
    {"CIM_SystemComponent",         "CIM_SystemDevice"},
    {"CIM_ProductElementComponent", "CIM_ProductPhysicalComponent"},
    {"CIM_Dependency",              "CIM_AssociatedAlarm CIM_DeviceConnection CIM_DeviceSAPImplementation CIM_ElementSoftwareIdentity "
                                    "CIM_Realizes CIM_RecordAppliesToElement CIM_ReferencedSpecification CIM_ServiceAccessBySAP "
                                    "CIM_HostedDependency"},
    {"CIM_DeviceConnection",        "CIM_ControlledBy"},
    {"CIM_ReferencedSpecification", "CIM_ReferencedProfile"},
    {"CIM_ReferencedProfile",       "CIM_SubProfileRequiresProfile"},
    {"CIM_ServiceAccessBySAP",      "CIM_CommMechanismForManager"},
    {"CIM_HostedDependency",        "CIM_HostedAccessPoint CIM_HostedCollection CIM_HostedService CIM_NamespaceInManager"},
    {"CIM_AbstractElementStatisticalData", "CIM_ElementStatisticalData"},
    {"CIM_InitiatorTargetLogicalUnitPath", "CIM_SCSIInitiatorTargetLogicalUnitPath"},
    {"CIM_ServiceAvailableToElement", "CIM_AvailableDiagnosticService"},
};
// clang-format on

std::map<std::string, std::string> superclasses()
{
    std::map<std::string, std::string> result;
    for (const Subclasses& row : tree)
    {
        std::istringstream names(row.names);
        for (std::string name; names >> name;)
            result[name] = row.superclass;
    }
    return result;
}

std::string keys_of(const Meta_Class& meta_class)
{
    std::string keys;
    for (uint32 i = 0; i < meta_class.num_meta_features; i++)
    {
        const Meta_Feature* feature = meta_class.meta_features[i];
        if (!is_key(feature))
            continue;
        keys += keys.empty() ? "" : " ";
        keys += feature->name;
        if (is_reference(feature))
            keys += std::string(">") + as_reference(feature)->meta_class->name;
    }
    return keys;
}

TEST(Catalogue, holds_the_served_classes_and_their_ancestors)
{
    uint32 served = 0;
    for (uint32 i = 0; i < meta_repository().num_meta_classes; i++)
        served += std::string(meta_repository().meta_classes[i]->name).starts_with("ZEMLAR_") ? 1 : 0;

    EXPECT_EQ(meta_repository().num_meta_classes, 177u);
    EXPECT_EQ(served, std::size(catalogue));
}

TEST(Catalogue, every_served_class_has_its_superclass_and_its_keys_in_order)
{
    for (const Served_Class& expected : catalogue)
    {
        SCOPED_TRACE(expected.name);
        const Meta_Class* meta_class = find_meta_class(&meta_repository(), expected.name);
        ASSERT_NE(meta_class, nullptr);
        ASSERT_NE(meta_class->super_meta_class, nullptr);
        EXPECT_STREQ(meta_class->super_meta_class->name, expected.superclass);
        EXPECT_EQ(keys_of(*meta_class), expected.keys);
    }
}

TEST(Catalogue, every_served_class_descends_from_its_root_by_the_standard_classes)
{
    const std::map<std::string, std::string> expected = superclasses();
    for (const Served_Class& served : catalogue)
    {
        const Meta_Class* step = find_meta_class(&meta_repository(), served.superclass);
        if (std::string(served.superclass).starts_with("ZEMLAR_"))
            step = step->super_meta_class;
        for (; step; step = step->super_meta_class)
        {
            ASSERT_TRUE(expected.contains(step->name)) << step->name;
            EXPECT_EQ(expected.at(step->name), step->super_meta_class ? step->super_meta_class->name : "") << step->name;
        }
    }
}

// What a provider offers must be what its class is.
TEST(Catalogue, every_registered_class_is_of_the_kind_that_its_provider_serves)
{
    enum Kind : uint32
    {
        INSTANCE = 0,
        ASSOCIATION = Flag_Association,
        INDICATION = Flag_Indication
    };
    struct Row
    {
        const char* class_name;
        uint32 kind;
    };
    constexpr Row rows[] = {
#define ZMLR_PROVIDER(class_name, interfaces, state) {#class_name, interfaces},
#include "providers/providers.def"
#undef ZMLR_PROVIDER
    };

    EXPECT_EQ(std::size(rows), 75u); // all but the abstraction over the diagnostic tests
    for (const Row& row : rows)
    {
        const Meta_Class* meta_class = find_meta_class(&meta_repository(), row.class_name);
        ASSERT_NE(meta_class, nullptr) << row.class_name;
        EXPECT_EQ(meta_class->flags & (Flag_Association | Flag_Indication), row.kind) << row.class_name;
        EXPECT_EQ(meta_class->flags & Flag_Abstract, 0u) << row.class_name;
    }
}

} // namespace
} // namespace zmlr
