// Requests for the counters of physical and logical ports.
#include "sim/commands/caller_memory.h"
#include "sim/commands/lport_requests.h"
#include "sim/commands/row.h"

#include <cerrno>

namespace hxasim
{

namespace
{

void answer_port(Call& call, hxa_ioctl_port_stats_t& record)
{
    hxa_pport_stats_t counters{};
    if (record.buf_size != sizeof(counters))
        return call.refuse(EINVAL, "buffer of " + std::to_string(record.buf_size) + " bytes, must be 304");
    if (call.ioc->adapter->converged())
        counters.eth = call.ioc->port->counters.ethernet.read();
    else
        counters.fc = call.ioc->port->counters.fc.read();
    const auto* bytes = reinterpret_cast<const std::uint8_t*>(&counters);
    if (!copy_to_caller(address_of(record.buf_ptr), {bytes, sizeof(counters)}))
        call.refuse(EFAULT, "bad address of the counters");
}

void answer_port_reset(Call& call, hxa_ioctl_gen_t&)
{
    auto& counters = call.ioc->port->counters;
    counters.fc.reset();
    counters.ethernet.reset();
    if (call.ioc->type == HXA_IOC_TYPE_LL)
        counters.ethernet_function.reset();
}

void answer_fcoe(Call& call, hxa_ioctl_fcport_stats_t& record)
{
    if (call.ioc->adapter->converged())
        record.stats.fcoe = call.ioc->port->counters.fcoe.read();
    else
        record.stats.fcqos = call.ioc->port->counters.qos.read();
}

void answer_fcoe_reset(Call& call, hxa_ioctl_gen_t&)
{
    call.ioc->port->counters.fcoe.reset();
    call.ioc->port->counters.qos.reset();
}

void answer_lport(Call& call, hxa_ioctl_lport_stats_t& record)
{
    if (const auto* logical = logical_port_of(call, record, record.pwwn))
        record.stats = logical->counters.read();
}

constexpr auto buffer = [](auto& record) { return std::tie(record.buf_size, record.buf_ptr); };
constexpr auto logical_port = [](auto& record) { return std::tie(record.vf_id, record.pwwn); };
constexpr auto statistics_buffers = [](const auto& record) { return std::vector{Buffer{record.buf_ptr, record.buf_size}}; };

// clang-format off
constexpr Row statistics_table[] = {
    ioc_row<answer_port>(      "IOCMD_PORT_GET_STATS",   buffer, statistics_buffers),
    ioc_row<answer_port_reset>("IOCMD_PORT_RESET_STATS"),
    ioc_row<answer_fcoe>(      "IOCMD_FCOE_GET_STATS"),
    ioc_row<answer_fcoe_reset>("IOCMD_FCOE_RESET_STATS"),
    ioc_row<answer_lport>(     "IOCMD_LPORT_GET_STATS",  logical_port),
};
// clang-format on

} // namespace

std::span<const Row> statistics_rows() { return statistics_table; }

} // namespace hxasim
