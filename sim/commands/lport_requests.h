// What requests to logical and remote ports have in common: finding their objects.
#pragma once

#include "sim/commands/command.h"

namespace hxasim
{

// Whether the FC function of the port is logged into the fabric.
inline bool is_on_line(const Ioc& ioc) { return port_state(ioc) == HXA_PPORT_ST_LINKUP; }

// The logical port with this WWN in the record's virtual fabric; null, with the record's status set, when there is none.
template <typename Record> Logical_Port* logical_port_of(Call& call, Record& record, wwn_t wwn)
{
    if (call.ioc->type == HXA_IOC_TYPE_LL)
    {
        record.status = HXA_STATUS_ENOFCPORTS;
        return nullptr;
    }
    auto& port = *call.ioc->port;
    bool is_base = std::memcmp(port.base_port.pwwn.data(), &wwn, sizeof(wwn)) == 0;
    auto* logical = is_base ? &port.base_port : port_with_wwn(port.virtual_ports, wwn);
    if (logical && logical->virtual_fabric == record.vf_id)
        return logical;
    record.status = logical ? HXA_STATUS_UNKNOWN_VFID : HXA_STATUS_UNKNOWN_LWWN;
    return nullptr;
}

// The remote port that the driver knows behind a logical port; null, with the record's status set, when there is none.
template <typename Record> Remote_Port* remote_port_of(Call& call, Record& record, wwn_t logical_wwn, wwn_t wwn)
{
    auto* logical = logical_port_of(call, record, logical_wwn);
    if (!logical)
        return nullptr;
    auto* remote = port_with_wwn(logical->remote_ports, wwn);
    if (remote && remote->known)
        return remote;
    record.status = HXA_STATUS_UNKNOWN_RWWN;
    return nullptr;
}

// The same for a target; any other remote port has no nexus.
template <typename Record> Remote_Port* target_of(Call& call, Record& record, wwn_t logical_wwn, wwn_t wwn)
{
    auto* remote = remote_port_of(call, record, logical_wwn, wwn);
    if (!remote || remote->is_target())
        return remote;
    record.status = HXA_STATUS_NO_FCPIM_NEXUS;
    return nullptr;
}

} // namespace hxasim
