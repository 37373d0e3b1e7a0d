#include "inventory/provider_init.h"

#include "hxal/hxal.h"
#include "runtime/log.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "ProviderInit";

void log_library_status(int status) { ZMLR_LOG(LL_INFO, "hxal_get_last_error returns %s ", hxal_status_to_string(status)); }

Driver_Status status_without_adapters(hxa_status_t error)
{
    switch (error)
    {
    case HXA_STATUS_NO_DRIVER:
        ZMLR_LOG(LL_ERR, "ERROR: No driver found");
        return DRIVER_MISSING;
    case HXA_STATUS_VERSION_FAIL:
        ZMLR_LOG(LL_ERR, "ERROR: HXAL version mismatch");
        return DRIVER_VERSION_FAIL;
    default:
        log_library_status(error);
        if (error == HXA_STATUS_OK && hxal_ioc_get_num() > 0) // a hole among the instances ends the scan without an error
            ZMLR_LOG(LL_WARN, "WARNING: A driver answers, but there are no adapters: it counts more IOCs than it has");
        return DRIVER_FAILURE;
    }
}

Driver_Status probe()
{
    ZMLR_LOG(LL_INFO, "Inside ProviderInit Constructor.");
    const int result = hxal_libinit(hxa_aen_app_cim);
    ZMLR_LOG(LL_INFO, "hxal_libinit() returned  %d ", result);

    const int adapters = hxal_adapter_scan();
    ZMLR_LOG(LL_DBG, "Adapter Count = %d\n", adapters);
    if (adapters <= 0)
        return status_without_adapters(hxal_get_last_error());

    log_library_status(result);
    return DRIVER_GOOD;
}

[[maybe_unused]] const Driver_Status status_at_load = ProviderInit::getDriverStatus();

} // namespace

ProviderInit::ProviderInit() : _driver_status(probe()) {}

Driver_Status ProviderInit::getDriverStatus()
{
    static const ProviderInit object;
    return object._driver_status;
}

} // namespace zmlr
