// Requests to the nexus between a logical port and a remote target.
#include "sim/commands/lport_requests.h"
#include "sim/commands/row.h"

namespace hxasim
{

namespace
{

void answer_itnim_attributes(Call& call, hxa_ioctl_itnim_attr_t& record)
{
    const auto* target = target_of(call, record, record.lpwwn, record.rpwwn);
    if (!target)
        return;
    const auto& nexus = target->nexus;
    bool on_line = is_on_line(*call.ioc) && target->state == HXA_RPORT_ONLINE;
    record.attr.state = on_line ? nexus.state : std::uint32_t{HXA_ITNIM_OFFLINE};
    record.attr.retry = nexus.retry;
    record.attr.task_retry_id = nexus.task_retry_id;
    record.attr.rec_support = nexus.rec_support;
    record.attr.conf_comp = nexus.conf_comp;
    record.attr.io_latency = nexus.latency;
}

void answer_itnim_statistics(Call& call, hxa_ioctl_itnim_stats_t& record)
{
    if (const auto* target = target_of(call, record, record.lpwwn, record.rpwwn))
        record.stats = target->nexus.counters.read();
}

void answer_itnim_reset_statistics(Call& call, hxa_ioctl_itnim_reset_stats_t& record)
{
    if (auto* target = target_of(call, record, record.lpwwn, record.rpwwn))
        target->nexus.counters.reset();
}

constexpr auto nexus = [](auto& record) { return std::tie(record.vf_id, record.lpwwn, record.rpwwn); };

// clang-format off
constexpr Row itnim_table[] = {
    ioc_row<answer_itnim_attributes>(      "IOCMD_ITNIM_GET_ATTR",    nexus),
    ioc_row<answer_itnim_statistics>(      "IOCMD_ITNIM_GET_STATS",   nexus),
    ioc_row<answer_itnim_reset_statistics>("IOCMD_ITNIM_RESET_STATS", nexus),
};
// clang-format on

} // namespace

std::span<const Row> itnim_rows() { return itnim_table; }

} // namespace hxasim
