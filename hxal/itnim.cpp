#include "hxal/itnim.h"

#include "hxal/internal/request.h"

namespace
{

template <typename Record> Record nexus_request_for(const hxal_s& ioc, uint16_t vf_id, wwn_t lpwwn, wwn_t rpwwn)
{
    auto record = hxal::request_for<Record>(ioc);
    record.vf_id = vf_id;
    record.lpwwn = lpwwn;
    record.rpwwn = rpwwn;
    return record;
}

} // namespace

hxa_status_t hxal_itnim_get_attr(const hxal_t* ioc, uint16_t vf_id, wwn_t lpwwn, wwn_t rpwwn, hxa_itnim_attr_t* attr)
{
    if (!ioc || !attr)
        return HXA_STATUS_EINVAL;
    auto record = nexus_request_for<hxa_ioctl_itnim_attr_t>(*ioc, vf_id, lpwwn, rpwwn);
    if (const hxa_status_t sent = hxal::send(*ioc, "IOCMD_ITNIM_GET_ATTR", record); sent != HXA_STATUS_OK)
        return sent;
    if (hxa_itnim_latency_t& latency = record.attr.io_latency; latency.count != 0)
        latency.avg = latency.avg * latency.clock_res / latency.count;
    *attr = record.attr;
    return record.status;
}

hxa_status_t hxal_itnim_get_stats(const hxal_t* ioc, uint16_t vf_id, wwn_t lpwwn, wwn_t rpwwn, hxa_itnim_stats_t* stats)
{
    if (!ioc || !stats)
        return HXA_STATUS_EINVAL;
    auto record = nexus_request_for<hxa_ioctl_itnim_stats_t>(*ioc, vf_id, lpwwn, rpwwn);
    return hxal::exchange(*ioc, "IOCMD_ITNIM_GET_STATS", record, &hxa_ioctl_itnim_stats_t::stats, stats);
}

hxa_status_t hxal_itnim_reset_stats(const hxal_t* ioc, uint16_t vf_id, wwn_t lpwwn, wwn_t rpwwn)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = nexus_request_for<hxa_ioctl_itnim_reset_stats_t>(*ioc, vf_id, lpwwn, rpwwn);
    return hxal::exchange(*ioc, "IOCMD_ITNIM_RESET_STATS", record);
}
