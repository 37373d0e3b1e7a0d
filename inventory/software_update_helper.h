// SoftwareUpdateHelper: the service that installs software on the adapters, and what it can do.
#pragma once

#include "inventory/class_id.h"
#include "inventory/hba_info.h"
#include "inventory/inventory_request.h"
#include "runtime/instance.h"
#include "schema/ZEMLAR_HBASoftwareInstallationService.h"
#include "schema/ZEMLAR_HBASoftwareInstallationServiceCapabilities.h"
#include "schema/ZEMLAR_PortController.h"

namespace zmlr
{

// Of the record only the host is used.
Ref<ZEMLAR_HBASoftwareInstallationService> getHBASoftwareInstallationServiceInstance(const _hbaInfo& info);
Ref<ZEMLAR_HBASoftwareInstallationServiceCapabilities>
getHBASoftwareInstallationServiceCapabilitiesInstance(const _hbaInfo& info);

class SoftwareUpdateHelper
{
public:
    static const SoftwareUpdateHelper& getSoftwareUpdateHelperInstance();

    // One instance of the class: the service is the host's, not an adapter's.
    Instance_Array getInstancesByClass(classId_t id, const Inventory_Request& request = {}) const;

    // Writes the boot code of an archive to the controller's adapter, through its first IOC. The status of
    // hxal_boot_fwupdate() (hxal/boot.h), HXA_STATUS_NO_ADAPTER when the adapter is not there. One update at a time.
    int UpdatePortControllerSoftware(const ZEMLAR_PortController& controller, const char* file) const;

private:
    SoftwareUpdateHelper() = default;
};

} // namespace zmlr
