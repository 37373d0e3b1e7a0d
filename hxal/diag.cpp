#include "hxal/diag.h"

#include "hxal/internal/request.h"

hxa_status_t hxal_diag_get_lb_status(const hxal_t* ioc)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_diag_lb_stat_t>(*ioc);
    return hxal::exchange(*ioc, "IOCMD_DIAG_LB_STAT", record);
}
