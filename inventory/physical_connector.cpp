#include "inventory/physical_connector.h"

#include "inventory/class_id.h"
#include "inventory/property_text.h"
#include "inventory/provider_util.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "PhysicalAssetHelper";

} // namespace

Ref<ZEMLAR_PhysicalConnector> getPhysicalConnectorInstance(const _sfpInfo& info)
{
    const Scope_Trace trace(log_source);
    constexpr uint16 CONNECTOR_TYPE = 118; // CIM_PhysicalConnector.ConnectorType
    constexpr uint16 GENDER_UNKNOWN = 0;   // CIM_PhysicalConnector.ConnectorGender
    constexpr uint16 LAYOUT_OTHER = 1;     // CIM_PhysicalConnector.ConnectorLayout
    const String class_name = ProviderUtil::getClassName(CLASSID_PhysicalConnector);

    Ref<ZEMLAR_PhysicalConnector> connector(ZEMLAR_PhysicalConnector::create());
    connector->CreationClassName.set(class_name);
    connector->Caption.set(class_name);
    connector->ElementName.set(class_name);
    connector->Tag.set(property_text(info.tag));
    connector->Manufacturer.set(property_text(info.vendor_name));
    connector->PartNumber.set(property_text(info.part_number));
    connector->SerialNumber.set(property_text(info.serial_number));
    connector->Model.set(info.kind);
    connector->Version.set(property_text(info.revision));
    connector->Description.set(info.media);
    connector->ConnectorType.set({CONNECTOR_TYPE});
    connector->ConnectorPinout.set("0");
    connector->ConnectorGender.set(GENDER_UNKNOWN);
    connector->NumPhysicalPins.set(0);
    connector->ConnectorLayout.set(LAYOUT_OTHER);
    return connector;
}

} // namespace zmlr
