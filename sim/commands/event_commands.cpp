// Requests for the events that the drivers queue.
#include "sim/commands/row.h"

#include <algorithm>
#include <cerrno>

namespace hxasim
{

namespace
{

bool is_application(Call& call, std::uint32_t identity)
{
    if (identity > max_application)
        call.refuse(EINVAL, "no such application: " + std::to_string(identity));
    return identity <= max_application;
}

// An application that synchronises on a node learns of the IOCs there, and waits for the events of those.
void answer_sync(Call& call, hxa_ioctl_aen_t& record)
{
    if (!is_application(call, record.app_id))
        return;
    call.descriptor.application = record.app_id;
    call.descriptor.known.reset();
    for (const auto& ioc : call.host.iocs(call.descriptor.node))
        call.descriptor.known.set(ioc.instance, ioc.adapter->plugged);
    call.host.tell_event_news();
    record.status = HXA_STATUS_OK;
}

void answer_fetch(Call& call, hxal_ioctl_aen_t& record)
{
    if (!is_application(call, record.app_id))
        return;
    if (record.aen_count < 0)
        return call.refuse(EINVAL, "room for " + std::to_string(record.aen_count) + " events");
    if (call.descriptor.application != record.app_id)
        return call.refuse(EINVAL, "application " + std::to_string(record.app_id) + " has not synchronised on this descriptor");
    const auto room = static_cast<std::size_t>(std::min(record.aen_count, HXA_AEN_MAX_ENTRIES));
    const auto count = call.ioc->events.take(record.app_id, {record.aen_list, room});
    record.aen_count = static_cast<std::int32_t>(count);
    record.status = HXA_STATUS_OK;
    call.answer_size = offsetof(hxal_ioctl_aen_t, aen_list) + count * sizeof(hxa_aen_entry_t);
    call.host.tell_event_news();
}

constexpr auto application = [](auto& record) { return std::tie(record.app_id); };
constexpr auto room = [](auto& record) { return std::tie(record.aen_count, record.app_id); };

// clang-format off
constexpr Row event_table[] = {
    driver_row<answer_sync>("IOCMD_AEN_SYNC", application),
    ioc_row<answer_fetch>(  "IOCMD_AEN_GET",  room),
};
// clang-format on

} // namespace

std::span<const Row> event_rows() { return event_table; }

} // namespace hxasim
