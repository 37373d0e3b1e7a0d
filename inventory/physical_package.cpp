#include "inventory/physical_package.h"

#include "inventory/class_id.h"
#include "inventory/property_text.h"
#include "inventory/provider_util.h"
#include "runtime/trace.h"

#include <cstdio>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "AdapterHelper";

// The address in the form of a UUID.
String tag_of(const _hbaInfo& info)
{
    char tag[64];
    if (info.is_cna)
        std::snprintf(tag, sizeof tag, "10000000-0000-0000-0000-%s", info.mac);
    else
        std::snprintf(tag, sizeof tag, "10000000-0000-0000-%.4s-%s", info.node_wwn, info.node_wwn + 4);
    return tag;
}

} // namespace

Ref<ZEMLAR_PhysicalPackage> getPhysicalPackageInstance(const _hbaInfo& info)
{
    const Scope_Trace trace(log_source);
    Ref<ZEMLAR_PhysicalPackage> package(ZEMLAR_PhysicalPackage::create());
    package->CreationClassName.set(ProviderUtil::getClassName(CLASSID_PhysicalPackage));
    package->Tag.set(tag_of(info));
    package->Manufacturer.set(property_text(info.manufacturer));
    package->Model.set(property_text(info.model));
    package->SerialNumber.set(property_text(info.serial_number));
    package->FRUNumber.set(property_text(info.fru_number));
    package->Caption.set(info.display_name());
    package->ElementName.set(info.display_name());
    return package;
}

} // namespace zmlr
