// FC pass-through: one frame of the caller's making from a logical port into the fabric, and the answer.
#pragma once

#include "hxal/ioc.h"
#include "hxal/records/fcpt.h"
#include "hxal/records/port.h"

#ifdef __cplusplus
extern "C"
{
#endif

    // Sends `reqsz` bytes behind the frame header `fchs` (FC-FS-2, in the order of the wire) from the logical port `lpwwn` of the
    // virtual fabric `vf_id`, in class `cos`, and waits up to `tsecs` seconds for the response. `dpwwn` is the remote port whose
    // login the frame needs, 0 when it needs none. `cts` goes to the driver as it is.
    // `*rspsz` is the room in `rspbuf`, in bytes, and after a request that did not fail the length that the driver gives: do not
    // trust it beyond the room. A buffer may be null when its size is 0; the driver uses both only while the call lasts.
    hxa_status_t hxal_fcpt(const hxal_t* ioc, uint16_t vf_id, wwn_t lpwwn, wwn_t dpwwn, uint32_t tsecs, hxa_boolean_t cts,
                           fc_cos_t cos, const fchs_t* fchs, const void* reqbuf, uint32_t reqsz, void* rspbuf, uint32_t* rspsz);

#ifdef __cplusplus
}
#endif
