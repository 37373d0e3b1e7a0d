#include "hxal/fcpt.h"

#include "hxal/internal/request.h"

hxa_status_t hxal_fcpt(const hxal_t* ioc, uint16_t vf_id, wwn_t lpwwn, wwn_t dpwwn, uint32_t tsecs, hxa_boolean_t cts,
                       fc_cos_t cos, const fchs_t* fchs, const void* reqbuf, uint32_t reqsz, void* rspbuf, uint32_t* rspsz)
{
    if (!ioc || !fchs || !rspsz || (!reqbuf && reqsz != 0) || (!rspbuf && *rspsz != 0))
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_fcpt_t>(*ioc);
    record.vf_id = vf_id;
    record.lpwwn = lpwwn;
    record.dpwwn = dpwwn;
    record.nport_nexus_needed = dpwwn != 0;
    record.tsecs = tsecs;
    record.cts = cts;
    record.cos = cos;
    record.fchs = *fchs;
    record.reqsz = reqsz;
    record.reqbuf_ptr = hxal::sender_address(reqbuf);
    record.rspsz = *rspsz;
    record.rspbuf_ptr = hxal::sender_address(rspbuf);
    return hxal::exchange(*ioc, "IOCMD_FCPT", record, &hxa_ioctl_fcpt_t::rspsz, rspsz);
}
