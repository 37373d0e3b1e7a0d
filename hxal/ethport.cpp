#include "hxal/ethport.h"

#include "hxal/internal/request.h"

hxa_status_t hxal_ethport_get_attr(const hxal_t* ioc, hxa_ethport_attr_t* attr)
{
    return hxal::read(ioc, "IOCMD_ETHPORT_GET_ATTR", &hxa_ioctl_ethport_attr_t::attr, attr);
}

hxa_status_t hxal_ethport_get_stats(const hxal_t* ioc, hxa_ethport_stats_t* stats)
{
    return hxal::read_or_tell(ioc, "IOCMD_ETHPORT_GET_STATS", &hxa_ioctl_ethport_stats_t::stats, stats);
}

hxa_status_t hxal_ethport_reset_stats(const hxal_t* ioc) { return hxal::request(ioc, "IOCMD_PORT_RESET_STATS"); }
