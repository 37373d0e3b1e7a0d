#include "hxal/port.h"

#include "hxal/internal/request.h"

hxa_status_t hxal_port_get_attr(const hxal_t* ioc, hxa_pport_attr_t* attr)
{
    if (!ioc || !attr)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_port_attr_t>(*ioc);
    return hxal::exchange(*ioc, "IOCMD_PORT_GET_ATTR", record, &hxa_ioctl_port_attr_t::attr, attr);
}
