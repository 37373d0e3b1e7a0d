// The associations of the host, its adapters, ports and logical units: what each joins, how, and what it logs when a side is
// empty.
#pragma once

#include "providers/join.h"
#include "providers/matches_inventory.h"
#include "schema/CIM_LogicalDevice.h"
#include "schema/ZEMLAR_AdapterElementSoftwareIdentity.h"
#include "schema/ZEMLAR_AssociatedAlarm.h"
#include "schema/ZEMLAR_ControlledBy.h"
#include "schema/ZEMLAR_DeviceSAPImplementation.h"
#include "schema/ZEMLAR_ElementStatisticalData.h"
#include "schema/ZEMLAR_EthernetPortControlledBy.h"
#include "schema/ZEMLAR_EthernetPortRealizes.h"
#include "schema/ZEMLAR_EthernetPortSystemDevice.h"
#include "schema/ZEMLAR_FCPortSystemDevice.h"
#include "schema/ZEMLAR_HBASoftwareInstallationServiceElementCapabilities.h"
#include "schema/ZEMLAR_HBASoftwareInstallationServiceHostedService.h"
#include "schema/ZEMLAR_HostedAccessPoint.h"
#include "schema/ZEMLAR_HostedCollection.h"
#include "schema/ZEMLAR_HostedDependency.h"
#include "schema/ZEMLAR_HostedLANEndpoint.h"
#include "schema/ZEMLAR_InstalledSoftwareIdentity.h"
#include "schema/ZEMLAR_LANEndpointDeviceSAPImplementation.h"
#include "schema/ZEMLAR_MemberOfCollection.h"
#include "schema/ZEMLAR_PhysicalConnectorContainer.h"
#include "schema/ZEMLAR_PortControllerSystemDevice.h"
#include "schema/ZEMLAR_ProductElementComponent.h"
#include "schema/ZEMLAR_ProductPhysicalComponent.h"
#include "schema/ZEMLAR_Realizes.h"
#include "schema/ZEMLAR_RemoteServiceHostedAccessPoint.h"
#include "schema/ZEMLAR_SCSIInitiatorTargetLogicalUnitPath.h"
#include "schema/ZEMLAR_StorageResourcesSystemDevice.h"

namespace zmlr
{

// clang-format off
inline constexpr Join inventory_joins[] = {

    // The host.
    join(all_pairs, side<&ZEMLAR_PortControllerSystemDevice::GroupComponent>({LL_ERR, "Error: Invalid mapping information"}),
                    side<&ZEMLAR_PortControllerSystemDevice::PartComponent>({LL_ERR, "Error: Invalid mapping information"})),
    join(all_pairs, side<&ZEMLAR_FCPortSystemDevice::GroupComponent>({LL_ERR, "Error: Invalid mapping information"}),
                    side<&ZEMLAR_FCPortSystemDevice::PartComponent>({LL_ERR, "Error: Invalid mapping information"})),
    join(all_pairs, side<&ZEMLAR_EthernetPortSystemDevice::GroupComponent>({LL_ERR, "Invalid mapping information"}),
                    side<&ZEMLAR_EthernetPortSystemDevice::PartComponent>({LL_ERR, "Invalid mapping information"})),
    join(all_pairs, side<&ZEMLAR_StorageResourcesSystemDevice::GroupComponent>(),
                    optional(side_of<ZEMLAR_StorageExtent, &ZEMLAR_StorageResourcesSystemDevice::PartComponent>()),
                    optional(side_of<ZEMLAR_TapeDrive, &ZEMLAR_StorageResourcesSystemDevice::PartComponent>())),
    join(all_pairs, side<&ZEMLAR_HostedAccessPoint::Antecedent>({LL_ERR, "Error: Invalid mapping information"}),
                    side<&ZEMLAR_HostedAccessPoint::Dependent>({LL_ERR, "Error: Invalid mapping information"})),
    join(all_pairs, side<&ZEMLAR_HostedLANEndpoint::Antecedent>({LL_ERR, "Error: Invalid number of ComputerSystem instances"}),
                    side<&ZEMLAR_HostedLANEndpoint::Dependent>({LL_ERR, "No Ethernet Port Found"})),
    join(all_pairs, side<&ZEMLAR_HostedCollection::Antecedent>({LL_ERR, "Error: Invalid mapping information"}),
                    side<&ZEMLAR_HostedCollection::Dependent>({LL_ERR, "No Logical Port Groups found!"})),
    join(all_pairs, side<&ZEMLAR_InstalledSoftwareIdentity::System>({LL_ERR, "Error: Invalid mapping information"}),
                    side<&ZEMLAR_InstalledSoftwareIdentity::InstalledSoftware>({LL_ERR, "Error: Invalid mapping information"})),
    join(all_pairs, side<&ZEMLAR_HBASoftwareInstallationServiceHostedService::Antecedent>({LL_ERR, "Error: Invalid mapping information"}),
                    side<&ZEMLAR_HBASoftwareInstallationServiceHostedService::Dependent>({LL_ERR, "Error: Invalid mapping information"})),
    join(all_pairs, side<&ZEMLAR_RemoteServiceHostedAccessPoint::Antecedent>({LL_ERR, "Error: Invalid mapping information"}),
                    side<&ZEMLAR_RemoteServiceHostedAccessPoint::Dependent>({LL_ERR, "Warning: No service is available"})),
    join(same_positions, exactly_one(side<&ZEMLAR_HBASoftwareInstallationServiceElementCapabilities::ManagedElement>({LL_ERR, "Error: Invalid mapping information for service"})),
                         side<&ZEMLAR_HBASoftwareInstallationServiceElementCapabilities::Capabilities>({LL_ERR, "Error: Invalid mapping information for capabilities"})),

    // The adapters.
    join(with_its_own, side<&ZEMLAR_ControlledBy::Antecedent>(),
                       of_each<fc_ports_of>(side<&ZEMLAR_ControlledBy::Dependent>())),
    join(with_its_own, side<&ZEMLAR_EthernetPortControlledBy::Antecedent>(),
                       of_each<ethernet_ports_of>(side<&ZEMLAR_EthernetPortControlledBy::Dependent>())),
    join(keys_within_its_own, side_without_role<ZEMLAR_PortController>({}, all_of<ZEMLAR_PortController>),
                              of_each<fc_ports_of>(side<&ZEMLAR_HostedDependency::Dependent, number_of<ZEMLAR_FCPort>>({LL_ERR, "There are no FCPORT instances returned"})),
                              of_each<ethernet_ports_of>(side<&ZEMLAR_HostedDependency::Antecedent, number_of<ZEMLAR_EthernetPort>>({LL_ERR, "There are no ETHPORT instances returned"}))),
    join(equal_keys, side<&ZEMLAR_ProductElementComponent::PartComponent, &ZEMLAR_PortController::Name>({LL_ERR, "Invalid mapping information."}),
                     side<&ZEMLAR_ProductElementComponent::GroupComponent, &ZEMLAR_Product::IdentifyingNumber>({LL_ERR, "Invalid mapping information."})),
    join(equal_keys, side<&ZEMLAR_ProductPhysicalComponent::PartComponent, &ZEMLAR_PhysicalPackage::SerialNumber>({LL_ERR, "Error: Improper Product Information!\n"}),
                     side<&ZEMLAR_ProductPhysicalComponent::GroupComponent, &ZEMLAR_Product::IdentifyingNumber>({LL_ERR, "Error: Improper Product Information!\n"})),
    join(equal_keys, side<&ZEMLAR_Realizes::Dependent, &ZEMLAR_PortController::DeviceID>({LL_ERR, "Error: Invalid number of instances returned!\n"}),
                     side<&ZEMLAR_Realizes::Antecedent, address_in_tag>({LL_ERR, "Error: Invalid number of instances returned!\n"})),
    join(software_on_controllers, side<&ZEMLAR_AdapterElementSoftwareIdentity::Antecedent>(),
                                  side<&ZEMLAR_AdapterElementSoftwareIdentity::Dependent>()),
    join(connectors_in_packages, side<&ZEMLAR_PhysicalConnectorContainer::PartComponent>({LL_ERR, "No Connectors retrieved\n"}),
                                 side<&ZEMLAR_PhysicalConnectorContainer::GroupComponent, address_in_tag>({LL_ERR, "No PhysicalPackage retrieved\n"})),
    join(ports_at_connectors, side<&ZEMLAR_EthernetPortRealizes::Antecedent>({LL_ERR, "No Connector Found"}),
                              of_each<ethernet_ports_beside>(side<&ZEMLAR_EthernetPortRealizes::Dependent>())),

    // The ports and logical units.
    join(equal_keys, side<&ZEMLAR_ElementStatisticalData::ManagedElement, &ZEMLAR_FCPort::DeviceID>({LL_ERR, "No FC Ports Found"}),
                     side<&ZEMLAR_ElementStatisticalData::Stats, &ZEMLAR_FCPortStatistics::InstanceID>({LL_ERR, "Invalid number of Port Statistice Instances!"})),
    join(equal_keys, side<&ZEMLAR_AssociatedAlarm::Dependent, &ZEMLAR_FCPort::DeviceID>({LL_ERR, "No FC Ports Found!"}),
                     side<&ZEMLAR_AssociatedAlarm::Antecedent, &ZEMLAR_AlarmDevice::DeviceID>({LL_ERR, "Invalid number of Instances!"})),
    join(equal_keys, side<&ZEMLAR_DeviceSAPImplementation::Antecedent, &ZEMLAR_FCPort::DeviceID>({LL_ERR, "Error: No FCPort found!"}),
                     side<&ZEMLAR_DeviceSAPImplementation::Dependent, &ZEMLAR_SCSIProtocolEndpoint::Name>({LL_ERR, "Error: Invalid number of instances returned"})),
    join(equal_keys, side<&ZEMLAR_MemberOfCollection::Member, &ZEMLAR_FCPort::DeviceID>({LL_ERR, "No FC Ports Found!"}),
                     side<&ZEMLAR_MemberOfCollection::Collection, &ZEMLAR_LogicalPortGroup::Name>({LL_ERR, "Error: Invalid number of instances returned!\n"})),
    join(equal_keys, side<&ZEMLAR_LANEndpointDeviceSAPImplementation::Antecedent, &ZEMLAR_EthernetPort::DeviceID>({LL_ERR, "No Ethernet Port Found"}),
                     with_remark(side<&ZEMLAR_LANEndpointDeviceSAPImplementation::Dependent, &ZEMLAR_LANEndpoint::MACAddress>({LL_ERR, "Error: Invalid mapping information!"}),
                                 {LL_ERR, "Invalid number of EndPoint instances "})),
    join(paths_to_units, optional(side_of<ZEMLAR_StorageExtent, &ZEMLAR_SCSIInitiatorTargetLogicalUnitPath::LogicalUnit, &ZEMLAR_StorageExtent::DeviceID>()),
                         optional(side_of<ZEMLAR_TapeDrive, &ZEMLAR_SCSIInitiatorTargetLogicalUnitPath::LogicalUnit, &ZEMLAR_TapeDrive::DeviceID>()),
                         side<&ZEMLAR_SCSIInitiatorTargetLogicalUnitPath::Initiator, &ZEMLAR_SCSIProtocolEndpoint::Name>({LL_ERR, "Error: Invalid number of instances returned!\n"})),
};
// clang-format on

} // namespace zmlr
