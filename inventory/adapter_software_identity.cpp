#include "inventory/adapter_software_identity.h"

#include "inventory/property_text.h"
#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "AdapterHelper";

struct Identity
{
    String id;
    String version;
    String label;
    Array<uint16> classifications;
};

Identity identity_of(const _hbaInfo& info, softwareType_t type, bool is_ethernet)
{
    const String address = info.address();
    switch (type)
    {
    case SOFTWARE_BIOS:
        return {address + "_bios", property_text(info.boot_code_version), String("BIOS for ") + info.display_name(), {type}};
    case SOFTWARE_FIRMWARE:
        return {
            address + "_firmware", property_text(info.firmware_version), String("Firmware for ") + info.display_name(), {type}};
    case SOFTWARE_DRIVER:
        if (is_ethernet)
            return {property_text(info.eth_driver_name), property_text(info.eth_driver_version), "Network driver", {type}};
        return {property_text(info.fc_driver_name), property_text(info.fc_driver_version), "Storage driver", {type}};
    default:
        ZMLR_LOG(LL_INFO, "Default case . Other software types");
        return {};
    }
}

} // namespace

Ref<ZEMLAR_AdapterSoftwareIdentity> getAdapterSoftwareIdentityInstance(const _hbaInfo& info, softwareType_t type,
                                                                       bool is_ethernet)
{
    const Scope_Trace trace(log_source);
    ZMLR_LOG(LL_INFO, "Software Type is : %s", type == SOFTWARE_DRIVER ? "Driver" : "Firmware");
    const Identity identity = identity_of(info, type, is_ethernet);

    Ref<ZEMLAR_AdapterSoftwareIdentity> software(ZEMLAR_AdapterSoftwareIdentity::create());
    software->InstanceID.set(identity.id);
    software->Manufacturer.set(property_text(info.manufacturer));
    software->Classifications.set(identity.classifications);
    software->VersionString.set(identity.version);
    software->ElementName.set(identity.label);
    software->Caption.set(identity.label);
    software->Description.set(identity.label);
    software->Name.set(identity.label);
    return software;
}

} // namespace zmlr
