// The nexus between a logical port and a remote target (FCP-4), named by both port WWNs and the virtual fabric.
//
// The requests are the FC driver's: an Ethernet IOC's driver refuses them.
#pragma once

#include "hxal/ioc.h"
#include "hxal/records/itnim.h"

#ifdef __cplusplus
extern "C"
{
#endif

    // Reads the attributes. The driver delivers the sum of all latencies; after a request that did not fail, `io_latency.avg` is
    // the average: sum times `clock_res` divided by `count`, in 32 bits, or the sum itself when `count` is 0.
    hxa_status_t hxal_itnim_get_attr(const hxal_t* ioc, uint16_t vf_id, wwn_t lpwwn, wwn_t rpwwn, hxa_itnim_attr_t* attr);

    // Reads the counters; sets them to 0.
    hxa_status_t hxal_itnim_get_stats(const hxal_t* ioc, uint16_t vf_id, wwn_t lpwwn, wwn_t rpwwn, hxa_itnim_stats_t* stats);
    hxa_status_t hxal_itnim_reset_stats(const hxal_t* ioc, uint16_t vf_id, wwn_t lpwwn, wwn_t rpwwn);

#ifdef __cplusplus
}
#endif
