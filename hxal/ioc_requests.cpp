#include "hxal/internal/request.h"

#include <cerrno>
#include <cstdio>
#include <cstring>

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
    auto record = hxal::request_for<hxa_ioctl_ioc_info_t>(*ioc);
    if (const hxa_status_t sent = hxal::send(*ioc, "IOCMD_IOC_GET_INFO", record); sent != HXA_STATUS_OK)
        return sent;
    *info = record;
    return record.status;
}

hxa_status_t hxal_ioc_get_attr(const hxal_t* ioc, hxa_ioc_attr_t* attr)
{
    if (!ioc || !attr)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_ioc_attr_t>(*ioc);
    if (const hxa_status_t sent = hxal::send(*ioc, "IOCMD_IOC_GET_ATTR", record); sent != HXA_STATUS_OK)
    {
        std::printf("IOCTL ERR  IOCMD_IOC_GET_ATTR   %s\n", std::strerror(errno));
        return sent;
    }
    *attr = record.attr;
    return record.status;
}

mac_t hxal_ioc_get_current_mac(hxal_t* ioc)
{
    hxa_ioctl_ioc_info_t info;
    if (hxal_ioc_get_info(ioc, &info) == HXA_STATUS_OK)
        ioc->current_mac = info.current_mac;
    return ioc ? ioc->current_mac : mac_t{};
}
