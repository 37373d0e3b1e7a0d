// Requests to a remote port.
#include "sim/commands/lport_requests.h"
#include "sim/commands/row.h"
#include "sim/model/record_fields.h"
#include "sim/model/state_changes.h"

namespace hxasim
{

namespace
{

std::uint32_t state_of(const Ioc& ioc, const Remote_Port& remote)
{
    return is_on_line(ioc) ? remote.state : std::uint32_t{HXA_RPORT_OFFLINE};
}

// A port that is nowhere in the fabric: the driver keeps it, and its login fails.
Remote_Port absent_port(wwn_t wwn)
{
    Remote_Port remote;
    std::memcpy(remote.pwwn.data(), &wwn, sizeof(wwn));
    remote.state = HXA_RPORT_OFFLINE;
    remote.function = 0;
    remote.frame_size = 0;
    remote.counters->plogis = 1;
    remote.counters->plogi_failed = 1;
    return remote;
}

// A port that the fabric has comes on line as soon as the driver knows it, and off line when it is to forget it.
void make_known(Call& call, const Logical_Port& logical, Remote_Port& remote, bool known)
{
    if (remote.known != known && state_of(*call.ioc, remote) == HXA_RPORT_ONLINE)
    {
        known ? log_in(remote) : log_out(remote);
        tell_remote_port(call.host, *call.ioc, logical, remote, known);
    }
    remote.known = known;
}

void answer_add(Call& call, hxa_ioctl_rport_t& record)
{
    auto* logical = logical_port_of(call, record, record.pwwn);
    if (!logical)
        return;
    if (auto* remote = port_with_wwn(logical->remote_ports, record.rpwwn))
        make_known(call, *logical, *remote, true);
    else if (record.rpwwn == 0)
        record.status = HXA_STATUS_INVALID_WWN;
    else if (logical->remote_ports.size() >= max_remote_ports)
        record.status = HXA_STATUS_ENOMEM;
    else
        logical->remote_ports.push_back(absent_port(record.rpwwn));
}

void answer_remove(Call& call, hxa_ioctl_rport_t& record)
{
    if (auto* remote = remote_port_of(call, record, record.pwwn, record.rpwwn))
        make_known(call, *logical_port_of(call, record, record.pwwn), *remote, false);
}

void answer_rport_attributes(Call& call, hxa_ioctl_rport_attr_t& record)
{
    const auto* remote = remote_port_of(call, record, record.pwwn, record.rpwwn);
    if (!remote)
        return;
    auto& field = record.attr;
    put_address(field.pwwn, remote->pwwn);
    put_address(field.nwwn, remote->nwwn);
    put_text(field.symname, remote->symbolic_name);
    field.cos_supported = FC_CLASS_3;
    field.fc_cos = FC_CLASS_3;
    field.pid = address_field(remote->address);
    field.df_sz = remote->frame_size;
    field.state = state_of(*call.ioc, *remote);
    field.scsi_function = remote->function;
    field.qos_attr = {.qos_priority = remote->qos_priority, .qos_flow_id = remote->qos_flow_id};
    field.curr_speed = remote->speed;
    field.trl_enforced = remote->rate_limited;
    field.assigned_speed = remote->assigned_speed;
}

void answer_rport_statistics(Call& call, hxa_ioctl_rport_stats_t& record)
{
    if (const auto* remote = remote_port_of(call, record, record.pwwn, record.rpwwn))
        record.stats = remote->counters.read();
}

void answer_rport_reset_statistics(Call& call, hxa_ioctl_rport_reset_stats_t& record)
{
    if (auto* remote = remote_port_of(call, record, record.pwwn, record.rpwwn))
        remote->counters.reset();
}

void answer_scsi_address(Call& call, hxa_ioctl_rport_scsi_addr_t& record)
{
    if (const auto* remote = target_of(call, record, record.pwwn, record.rpwwn))
    {
        record.host = call.ioc->instance;
        record.bus = remote->bus;
        record.target = remote->target;
    }
}

void answer_rport_speed(Call& call, hxa_ioctl_rport_set_speed_t& record)
{
    auto* remote = remote_port_of(call, record, record.pwwn, record.rpwwn);
    if (!remote)
        return;
    if (remote->speed != HXA_PPORT_SPEED_UNKNOWN)
        record.status = HXA_STATUS_RPSC_ENABLED;
    else if (record.speed != HXA_PPORT_SPEED_UNKNOWN && !is_link_speed(record.speed))
        record.status = HXA_STATUS_UNSUPP_SPEED;
    else
        remote->assigned_speed = record.speed;
}

constexpr auto remote_port = [](auto& record) { return std::tie(record.vf_id, record.pwwn, record.rpwwn); };
constexpr auto rport_speed = [](auto& record) { return std::tie(record.vf_id, record.pwwn, record.rpwwn, record.speed); };

// clang-format off
constexpr Row rport_table[] = {
    ioc_row<answer_add>(                   "IOCMD_RPORT_ADD",           remote_port),
    ioc_row<answer_remove>(                "IOCMD_RPORT_REMOVE",        remote_port),
    ioc_row<answer_rport_statistics>(      "IOCMD_RPORT_GET_STATS",     remote_port),
    ioc_row<answer_rport_reset_statistics>("IOCMD_RPORT_RESET_STATS",   remote_port),
    ioc_row<answer_rport_attributes>(      "IOCMD_RPORT_GET_ATTR",      remote_port),
    ioc_row<answer_scsi_address>(          "IOCMD_RPORT_GET_SCSI_ADDR", remote_port),
    ioc_row<answer_rport_speed>(           "IOCMD_RPORT_SET_SPEED",     rport_speed),
};
// clang-format on

} // namespace

std::span<const Row> rport_rows() { return rport_table; }

} // namespace hxasim
