#include "hxal/lport.h"

#include "hxal/internal/lport_request.h"

using hxal::lport_request_for;

hxa_status_t hxal_lport_get_attr(const hxal_t* ioc, uint16_t vf_id, wwn_t pwwn, hxa_port_attr_t* attr)
{
    if (!ioc || !attr)
        return HXA_STATUS_EINVAL;
    auto record = lport_request_for<hxa_ioctl_lport_attr_t>(*ioc, vf_id, pwwn);
    return hxal::exchange(*ioc, "IOCMD_LPORT_GET_ATTR", record, &hxa_ioctl_lport_attr_t::attr, attr);
}

hxa_status_t hxal_lport_reset_stats(const hxal_t* ioc, uint16_t vf_id, wwn_t pwwn)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = lport_request_for<hxa_ioctl_lport_reset_stats_t>(*ioc, vf_id, pwwn);
    return hxal::exchange(*ioc, "IOCMD_LPORT_RESET_STATS", record);
}

hxa_status_t hxal_lport_get_rports(const hxal_t* ioc, uint16_t vf_id, wwn_t pwwn, wwn_t* rports, uint32_t* nrports)
{
    if (!ioc || !nrports || (!rports && *nrports != 0))
        return HXA_STATUS_EINVAL;
    auto record = lport_request_for<hxa_ioctl_lport_get_rports_t>(*ioc, vf_id, pwwn);
    record.rbuf_ptr = hxal::sender_address(rports);
    record.nrports = *nrports;
    return hxal::exchange(*ioc, "IOCMD_LPORT_GET_RPORTS", record, &hxa_ioctl_lport_get_rports_t::nrports, nrports);
}
