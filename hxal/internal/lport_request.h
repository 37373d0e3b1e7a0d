// Requests that name a logical port.
#pragma once

#include "hxal/internal/request.h"

namespace hxal
{

template <typename Record> Record lport_request_for(const hxal_s& ioc, uint16_t vf_id, wwn_t pwwn)
{
    auto record = request_for<Record>(ioc);
    record.vf_id = vf_id;
    record.pwwn = pwwn;
    return record;
}

} // namespace hxal
