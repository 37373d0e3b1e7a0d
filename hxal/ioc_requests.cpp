#include "hxal/config/setters.h"
#include "hxal/internal/fixed_text.h"
#include "hxal/internal/request.h"

#include <cstdio>

namespace
{

constexpr uint32_t library_version = 0x1020;

} // namespace

hxa_status_t hxal_ioc_compare_versions(const hxal_t* ioc)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    hxa_ioctl_ioc_get_version_t record{};
    if (hxal::send(*ioc, "IOCMD_IOC_GET_VERSION", record) != HXA_STATUS_OK)
        return HXA_STATUS_EIO;
    if (record.status == HXA_STATUS_OK && record.version != library_version)
        std::printf("\nWARNING: Tessik and Driver versions dont match!!!\n\n");
    return record.status;
}

hxa_status_t hxal_ioc_get_info(const hxal_t* ioc, hxa_ioctl_ioc_info_t* info)
{
    if (!ioc || !info)
        return HXA_STATUS_EINVAL;
    *info = hxal::request_for<hxa_ioctl_ioc_info_t>(*ioc);
    return hxal::exchange(*ioc, "IOCMD_IOC_GET_INFO", *info);
}

hxa_status_t hxal_ioc_get_attr(const hxal_t* ioc, hxa_ioc_attr_t* attr)
{
    return hxal::read_or_tell(ioc, "IOCMD_IOC_GET_ATTR", &hxa_ioctl_ioc_attr_t::attr, attr);
}

hxa_status_t hxal_ioc_get_stats(const hxal_t* ioc, hxa_ioc_stats_t* stats)
{
    return hxal::read(ioc, "IOCMD_IOC_GET_STATS", &hxa_ioctl_ioc_stats_t::stats, stats);
}

hxa_status_t hxal_ioc_reset_stats(const hxal_t* ioc) { return hxal::request(ioc, "IOCMD_IOC_RESET_STATS"); }

hxa_status_t hxal_ioc_set_power(const hxal_t* ioc, hxa_pm_ds_t state)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_ioc_power_t>(*ioc);
    record.power = state;
    return hxal::exchange(*ioc, "IOCMD_IOC_SET_POWER", record);
}

hxa_status_t hxal_ioc_set_name(hxal_t* ioc, const char* name)
{
    if (!ioc || !name)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_ioc_set_adapter_name_t>(*ioc);
    hxal::put_text(record.name, name);
    const hxa_status_t status = hxal::exchange(*ioc, "IOCMD_IOC_SET_PORT_NAME", record);
    if (status != HXA_STATUS_OK)
        return status;
    hxal_config_ioc_name(ioc, name);
    hxal::keep_text(ioc->port_name, name);
    return HXA_STATUS_OK;
}

mac_t hxal_ioc_get_current_mac(hxal_t* ioc)
{
    hxa_ioctl_ioc_info_t info;
    if (hxal_ioc_get_info(ioc, &info) == HXA_STATUS_OK)
        ioc->current_mac = info.current_mac;
    return ioc ? ioc->current_mac : mac_t{};
}
