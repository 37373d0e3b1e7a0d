#include "hxal/ethport.h"

#include "hxal/internal/request.h"

#include <cerrno>
#include <cstdio>
#include <cstring>

hxa_status_t hxal_ethport_get_attr(const hxal_t* ioc, hxa_ethport_attr_t* attr)
{
    return hxal::read(ioc, "IOCMD_ETHPORT_GET_ATTR", &hxa_ioctl_ethport_attr_t::attr, attr);
}

hxa_status_t hxal_ethport_get_stats(const hxal_t* ioc, hxa_ethport_stats_t* stats)
{
    if (!ioc || !stats)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_ethport_stats_t>(*ioc);
    if (const hxa_status_t sent = hxal::send(*ioc, "IOCMD_ETHPORT_GET_STATS", record); sent != HXA_STATUS_OK)
    {
        std::printf("IOCTL ERR  IOCMD_ETHPORT_GET_STATS   %s\n", std::strerror(errno));
        return sent;
    }
    *stats = record.stats;
    return record.status;
}

hxa_status_t hxal_ethport_reset_stats(const hxal_t* ioc) { return hxal::request(ioc, "IOCMD_PORT_RESET_STATS"); }
