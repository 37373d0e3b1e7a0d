#include "hxal/fcoe.h"

#include "hxal/config/setters.h"
#include "hxal/internal/request.h"

hxa_status_t hxal_fcoe_port_enable(const hxal_t* ioc)
{
    const hxa_status_t status = hxal::request(ioc, "IOCMD_PORT_ENABLE");
    if (status == HXA_STATUS_OK)
        hxal_config_enable(ioc, HXA_TRUE);
    return status;
}

hxa_status_t hxal_fcoe_port_disable(const hxal_t* ioc)
{
    const hxa_status_t status = hxal::request(ioc, "IOCMD_PORT_DISABLE");
    if (status == HXA_STATUS_OK)
        hxal_config_enable(ioc, HXA_FALSE);
    return status;
}

hxa_status_t hxal_fcoe_reset_stats(const hxal_t* ioc) { return hxal::request(ioc, "IOCMD_FCOE_RESET_STATS"); }
