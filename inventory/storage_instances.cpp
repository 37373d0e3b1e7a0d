#include "inventory/storage_instances.h"

#include "inventory/address_text.h"
#include "inventory/cim_values.h"
#include "inventory/class_id.h"
#include "inventory/property_text.h"
#include "inventory/provider_util.h"
#include "runtime/log.h"
#include "runtime/trace.h"

#include <algorithm>
#include <cstdio>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "TargetHelper";

constinit Fixed_Text<50> extent_description("It is a unique identification for a Storage Extent");
constinit Fixed_Text<50> tape_description("It is a unique identification for a Tape Drive");

// How a name is told by its source: CIM_StorageExtent.NameFormat and NameNamespace.
struct Name_Kind
{
    std::uint32_t identifier_type;
    uint16 format;
    uint16 name_space;
};

// clang-format off
constexpr Name_Kind name_kinds[] = {
    {IDENTIFIER_SERIAL_NUMBER,  7, 7}, // SNVM, SNVM
    {IDENTIFIER_T10_VENDOR_ID, 11, 4}, // T10VID, VPD83Type1
    {IDENTIFIER_EUI_64,        10, 3}, // EUI64, VPD83Type2
    {IDENTIFIER_NAA,            9, 2}, // NAA, VPD83Type3
    {IDENTIFIER_SCSI_NAME,      1, 1}, // Other, Other
    {IDENTIFIER_UNAVAILABLE,    0, 0}, // Unknown, Unknown
};
// clang-format on

const Name_Kind* kind_of(const _hbaLunInfo& lun)
{
    const auto* found = std::ranges::find(name_kinds, lun.identifier_type, &Name_Kind::identifier_type);
    return found == std::end(name_kinds) ? nullptr : found;
}

template <std::size_t N> String trimmed(const char (&field)[N])
{
    char text[N];
    ProviderUtil::trimString(field, text);
    return property_text(text);
}

// Texts are trimmed one after the other: compilers differ in the order of operands, and trimming is logged.
String serial_name(const _hbaLunInfo& lun)
{
    const String vendor = trimmed(lun.vendor);
    const String product = trimmed(lun.product);
    return vendor + "+" + product + "+" + trimmed(lun.serial_number);
}

String name_of(const _hbaLunInfo& lun)
{
    if (lun.identifier_type == IDENTIFIER_SERIAL_NUMBER)
        return serial_name(lun);
    if (lun.identifier_type == IDENTIFIER_UNAVAILABLE)
        return "Unable To Fetch";
    return kind_of(lun) ? property_text(lun.identifier) : String();
}

String lun_text(const _hbaLunInfo& lun)
{
    char text[24];
    std::snprintf(text, sizeof text, "LUN_%u", lun_number(lun.lun));
    return text;
}

String device_id(const _hbaPortInfo& port, const _hbaLunInfo& lun)
{
    const String vendor = trimmed(lun.vendor);
    const String product = trimmed(lun.product);
    char text[128];
    std::snprintf(text, sizeof text, "%s_%s_%s_%s_LUN_%u", port.port_wwn, lun.target_wwn, vendor.c_str(), product.c_str(),
                  lun_number(lun.lun));
    return text;
}

// What disks and tapes have in common.
template <class T> Ref<T> unit_instance(classId_t id, const _hbaPortInfo& port, const _hbaLunInfo& lun, const String& description)
{
    const String device = device_id(port, lun);
    Ref<T> unit(T::create());
    unit->SystemCreationClassName.set(ProviderUtil::getClassName(CLASSID_ComputerSystem));
    unit->SystemName.set(property_text(port.host));
    unit->CreationClassName.set(ProviderUtil::getClassName(id));
    unit->DeviceID.set(device);
    unit->ElementName.set(lun_text(lun));
    unit->Name.set(name_of(lun));
    unit->OtherIdentifyingInfo.set({device});
    unit->IdentifyingDescriptions.set({description});
    unit->OperationalStatus.set({OPERATIONAL_STATUS_OK});
    return unit;
}

} // namespace

Ref<ZEMLAR_StorageExtent> getStorageExtentInstance(const _hbaPortInfo& port, const _hbaLunInfo& lun)
{
    const Scope_Trace trace(log_source);
    Ref<ZEMLAR_StorageExtent> extent = unit_instance<ZEMLAR_StorageExtent>(CLASSID_StorageExtent, port, lun, extent_description);
    if (const Name_Kind* kind = kind_of(lun))
    {
        extent->NameFormat.set(kind->format);
        extent->NameNamespace.set(kind->name_space);
    }
    else
        ZMLR_LOG(LL_WARN, "Default idType. Should not have reached here. ");
    ZMLR_LOG(LL_DBG, "returned Instance of StorageExtent. port WWN= %s", port.port_wwn);
    return extent;
}

Ref<ZEMLAR_TapeDrive> getTapeDriveInstance(const _hbaPortInfo& port, const _hbaLunInfo& lun)
{
    const Scope_Trace trace(log_source);
    Ref<ZEMLAR_TapeDrive> tape = unit_instance<ZEMLAR_TapeDrive>(CLASSID_TapeDrive, port, lun, tape_description);
    if (!kind_of(lun))
        ZMLR_LOG(LL_WARN, "Default case for lunInfo.idType. Should not have reached here. ");
    ZMLR_LOG(LL_DBG, "returned Instance of TapeDrive. port WWN= %s", port.port_wwn);
    return tape;
}

} // namespace zmlr
