#include "hxal/rport.h"

#include "hxal/internal/lport_request.h"
#include "hxal/port.h"

namespace
{

template <typename Record> Record rport_request_for(const hxal_s& ioc, uint16_t vf_id, wwn_t pwwn, wwn_t rpwwn)
{
    auto record = hxal::lport_request_for<Record>(ioc, vf_id, pwwn);
    record.rpwwn = rpwwn;
    return record;
}

// Replaces the WWN 0 by the base port's.
hxa_status_t resolve_base_port(const hxal_s& ioc, wwn_t& pwwn)
{
    if (pwwn != 0)
        return HXA_STATUS_OK;
    hxa_pport_attr_t attr;
    const hxa_status_t status = hxal_port_get_attr(&ioc, &attr);
    if (status == HXA_STATUS_OK)
        pwwn = attr.pwwn;
    return status;
}

} // namespace

hxa_status_t hxal_rport_add(const hxal_t* ioc, uint16_t vf_id, wwn_t pwwn, wwn_t rpwwn)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = rport_request_for<hxa_ioctl_rport_t>(*ioc, vf_id, pwwn, rpwwn);
    return hxal::exchange(*ioc, "IOCMD_RPORT_ADD", record);
}

hxa_status_t hxal_rport_remove(const hxal_t* ioc, uint16_t vf_id, wwn_t pwwn, wwn_t rpwwn)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = rport_request_for<hxa_ioctl_rport_t>(*ioc, vf_id, pwwn, rpwwn);
    return hxal::exchange(*ioc, "IOCMD_RPORT_REMOVE", record);
}

hxa_status_t hxal_rport_get_attr(const hxal_t* ioc, uint16_t vf_id, wwn_t pwwn, wwn_t rpwwn, hxa_rport_attr_t* attr)
{
    if (!ioc || !attr)
        return HXA_STATUS_EINVAL;
    if (const hxa_status_t status = resolve_base_port(*ioc, pwwn); status != HXA_STATUS_OK)
        return status;
    auto record = rport_request_for<hxa_ioctl_rport_attr_t>(*ioc, vf_id, pwwn, rpwwn);
    return hxal::exchange(*ioc, "IOCMD_RPORT_GET_ATTR", record, &hxa_ioctl_rport_attr_t::attr, attr);
}

hxa_status_t hxal_rport_get_stats(const hxal_t* ioc, uint16_t vf_id, wwn_t pwwn, wwn_t rpwwn, hxa_rport_stats_t* stats)
{
    if (!ioc || !stats)
        return HXA_STATUS_EINVAL;
    if (const hxa_status_t status = resolve_base_port(*ioc, pwwn); status != HXA_STATUS_OK)
        return status;
    auto record = rport_request_for<hxa_ioctl_rport_stats_t>(*ioc, vf_id, pwwn, rpwwn);
    return hxal::exchange(*ioc, "IOCMD_RPORT_GET_STATS", record, &hxa_ioctl_rport_stats_t::stats, stats);
}

hxa_status_t hxal_rport_reset_stats(const hxal_t* ioc, uint16_t vf_id, wwn_t pwwn, wwn_t rpwwn)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    if (const hxa_status_t status = resolve_base_port(*ioc, pwwn); status != HXA_STATUS_OK)
        return status;
    auto record = rport_request_for<hxa_ioctl_rport_reset_stats_t>(*ioc, vf_id, pwwn, rpwwn);
    return hxal::exchange(*ioc, "IOCMD_RPORT_RESET_STATS", record);
}

hxa_status_t hxal_rport_get_scsi_address(const hxal_t* ioc, uint16_t vf_id, wwn_t pwwn, wwn_t rpwwn, uint32_t* host,
                                         uint32_t* bus, uint32_t* target)
{
    if (!ioc || !host || !bus || !target)
        return HXA_STATUS_EINVAL;
    auto record = rport_request_for<hxa_ioctl_rport_scsi_addr_t>(*ioc, vf_id, pwwn, rpwwn);
    if (const hxa_status_t sent = hxal::send(*ioc, "IOCMD_RPORT_GET_SCSI_ADDR", record); sent != HXA_STATUS_OK)
        return sent;
    *host = record.host;
    *bus = record.bus;
    *target = record.target;
    return record.status;
}

hxa_status_t hxal_rport_set_speed(const hxal_t* ioc, uint16_t vf_id, wwn_t pwwn, wwn_t rpwwn, hxa_pport_speed_t speed)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = rport_request_for<hxa_ioctl_rport_set_speed_t>(*ioc, vf_id, pwwn, rpwwn);
    record.speed = speed;
    return hxal::exchange(*ioc, "IOCMD_RPORT_SET_SPEED", record);
}
