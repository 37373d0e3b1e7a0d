#include "hxal/iocfc.h"

#include "hxal/config/setters.h"
#include "hxal/internal/ioc_state.h"
#include "hxal/internal/request.h"

#include <cstdio>

hxa_status_t hxal_iocfc_get_attr(const hxal_t* ioc, hxa_iocfc_attr_t* attr)
{
    if (hxal::is_ethernet(ioc))
    {
        std::printf("Not an FC IOC\n");
        return HXA_STATUS_FAILED;
    }
    return hxal::read(ioc, "IOCMD_IOCFC_GET_ATTR", &hxa_ioctl_iocfc_attr_t::attr, attr);
}

hxa_status_t hxal_iocfc_get_stats(const hxal_t* ioc, hxa_iocfc_stats_t* stats)
{
    if (hxal::is_ethernet(ioc))
        return HXA_STATUS_FAILED;
    return hxal::read(ioc, "IOCMD_IOCFC_GET_STATS", &hxa_ioctl_iocfc_stats_t::stats, stats);
}

hxa_status_t hxal_iocfc_reset_stats(const hxal_t* ioc)
{
    // On the Ethernet node the number of this request means "enable": it must never go out.
    return hxal::is_ethernet(ioc) ? HXA_STATUS_FAILED : hxal::request(ioc, "IOCMD_IOCFC_RESET_STATS");
}

hxa_status_t hxal_ioc_intr_set(const hxal_t* ioc, hxa_boolean_t coalesce, uint16_t delay, uint16_t latency)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_iocfc_intr_t>(*ioc);
    record.attr = {.coalesce = coalesce, .latency = latency, .delay = delay};
    const hxa_status_t status = hxal::exchange(*ioc, "IOCMD_IOCFC_SET_INTR", record);
    if (status == HXA_STATUS_OK)
        hxal_config_iocfc_intr(ioc, coalesce, delay, latency);
    return status;
}

hxa_status_t hxal_iocfc_intr_set(const hxal_t* ioc, hxa_boolean_t coalesce, uint16_t delay, uint16_t latency)
{
    return hxal::is_ethernet(ioc) ? HXA_STATUS_FAILED : hxal_ioc_intr_set(ioc, coalesce, delay, latency);
}
