#include "inventory/software_update_helper.h"

#include "inventory/adapter_lookup.h"
#include "inventory/adapter_walk.h"
#include "inventory/builder.h"
#include "inventory/cim_values.h"
#include "inventory/property_text.h"
#include "inventory/provider_util.h"
#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "SoftwareUpdateHelper";
constexpr const char* service_name = "Zemlar Adapter Software Update Service";

// CIM_SoftwareInstallationServiceCapabilities.SupportedURISchemes, SupportedSynchronousActions
constexpr uint16 SCHEME_FILE = 3;
constexpr uint16 SCHEME_TFTP = 8;
constexpr uint16 INSTALL_FROM_URI = 5;

void append_service(Instance_Array& instances, const _hbaInfo& info)
{
    instances.adopt(getHBASoftwareInstallationServiceInstance(info));
}

void append_capabilities(Instance_Array& instances, const _hbaInfo& info)
{
    instances.adopt(getHBASoftwareInstallationServiceCapabilitiesInstance(info));
}

constexpr Builder<const _hbaInfo> software_builders[] = {
    {CLASSID_HBASoftwareInstallationService, append_service},
    {CLASSID_HBASoftwareInstallationServiceCapabilities, append_capabilities},
};

hxa_status_t update_through(hxal_t* first_ioc, const char* file)
{
    const Ioc_Handle ioc(first_ioc);
    ZMLR_LOG(LL_INFO, "calling hxal_boot_fwupdate() file=%s\n", file);
    const hxa_status_t status = hxal_boot_fwupdate(ioc.get(), file, 0);
    ZMLR_LOG(LL_INFO, "return from hxal_boot_fwupdate() - %d\n", static_cast<int>(status));
    return status;
}

} // namespace

Ref<ZEMLAR_HBASoftwareInstallationService> getHBASoftwareInstallationServiceInstance(const _hbaInfo& info)
{
    const Scope_Trace trace(log_source);
    Ref<ZEMLAR_HBASoftwareInstallationService> service(ZEMLAR_HBASoftwareInstallationService::create());
    service->SystemCreationClassName.set(ProviderUtil::getClassName(CLASSID_ComputerSystem));
    service->CreationClassName.set(ProviderUtil::getClassName(CLASSID_HBASoftwareInstallationService));
    service->SystemName.set(property_text(info.host));
    service->Name.set(service_name);
    return service;
}

Ref<ZEMLAR_HBASoftwareInstallationServiceCapabilities> getHBASoftwareInstallationServiceCapabilitiesInstance(const _hbaInfo&)
{
    const Scope_Trace trace(log_source);
    using Capabilities = ZEMLAR_HBASoftwareInstallationServiceCapabilities;
    Ref<Capabilities> capabilities(Capabilities::create());
    capabilities->InstanceID.set(service_name);
    capabilities->SupportedInstallOptions.set({INSTALL_OPTION_INSTALL, INSTALL_OPTION_UPDATE});
    capabilities->SupportedURISchemes.set({SCHEME_FILE, SCHEME_TFTP});
    capabilities->SupportedSynchronousActions.set({INSTALL_FROM_URI});
    return capabilities;
}

const SoftwareUpdateHelper& SoftwareUpdateHelper::getSoftwareUpdateHelperInstance()
{
    static constinit const SoftwareUpdateHelper helper;
    return helper;
}

Instance_Array SoftwareUpdateHelper::getInstancesByClass(classId_t id, const Inventory_Request& request) const
{
    const Scope_Trace trace(log_source);
    _hbaInfo info;
    copy_text(info.host, request.host.text());
    const _hbaInfo& reading = info;
    Instance_Array instances;
    build(instances, software_builders, id, reading, log_source, "Default case . Other classes ");
    ZMLR_LOG(LL_INFO, "Number of instances: %d", static_cast<int>(instances.size()));
    return instances;
}

int SoftwareUpdateHelper::UpdatePortControllerSoftware(const ZEMLAR_PortController& controller, const char* file) const
{
    const Scope_Trace trace(log_source);
    const String& address = controller.DeviceID.value;
    ZMLR_LOG(LL_INFO, "UpdatePortControllerSoftware portType=%d deviceid=%s file=%s", controller.ControllerType.value,
             address.c_str(), file);
    const hxal_adapter_t* adapter = hxal_adapter_open_idx(ProviderUtil::getAdapterId(address));
    hxal_t* first_ioc = hxal_adapter_get_first_ioc(adapter);
    if (!first_ioc)
        return HXA_STATUS_NO_ADAPTER;
    const hxa_status_t status = update_through(first_ioc, file);
    ZMLR_LOG(LL_INFO, "status=%d\n", static_cast<int>(status));
    return status;
}

} // namespace zmlr
