#include "hxal/iocfc.h"

#include "hxal/config/setters.h"
#include "hxal/internal/request.h"

#include <cstdio>

namespace
{

// On the Ethernet node the number of IOCMD_IOCFC_RESET_STATS means "enable": such a request must never go out.
bool is_ethernet(const hxal_t* ioc) { return ioc && ioc->ioc_type == HXA_IOC_TYPE_LL; }

} // namespace

hxa_status_t hxal_iocfc_get_attr(const hxal_t* ioc, hxa_iocfc_attr_t* attr)
{
    if (is_ethernet(ioc))
    {
        std::printf("Not an FC IOC\n");
        return HXA_STATUS_FAILED;
    }
    return hxal::read(ioc, "IOCMD_IOCFC_GET_ATTR", &hxa_ioctl_iocfc_attr_t::attr, attr);
}

hxa_status_t hxal_iocfc_get_stats(const hxal_t* ioc, hxa_iocfc_stats_t* stats)
{
    if (is_ethernet(ioc))
        return HXA_STATUS_FAILED;
    return hxal::read(ioc, "IOCMD_IOCFC_GET_STATS", &hxa_ioctl_iocfc_stats_t::stats, stats);
}

hxa_status_t hxal_iocfc_reset_stats(const hxal_t* ioc)
{
    return is_ethernet(ioc) ? HXA_STATUS_FAILED : hxal::request(ioc, "IOCMD_IOCFC_RESET_STATS");
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
    return is_ethernet(ioc) ? HXA_STATUS_FAILED : hxal_ioc_intr_set(ioc, coalesce, delay, latency);
}
