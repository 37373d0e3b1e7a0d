// Requests to the Ethernet side of a converged port, through either driver.
#include "sim/commands/row.h"

namespace hxasim
{

namespace
{

void answer_ethport_attributes(Call& call, hxa_ioctl_ethport_attr_t& record)
{
    const auto& ioc = *call.ioc;
    if (!ioc.adapter->converged())
    {
        record.status = HXA_STATUS_CMD_NOTSUPP;
        return;
    }
    auto& field = record.attr;
    field.mtu = ioc.port->mtu;
    field.speed_supported = ioc.port->speed_supported;
    field.port_state = port_state(ioc);
    field.speed = field.port_state == HXA_PPORT_ST_LINKUP ? ioc.port->speed : std::uint32_t{HXA_PPORT_SPEED_UNKNOWN};
}

void answer_ethport_statistics(Call& call, hxa_ioctl_ethport_stats_t& record)
{
    if (!call.ioc->adapter->converged())
        record.status = HXA_STATUS_CMD_NOTSUPP;
    else
        record.stats = call.ioc->port->counters.ethernet_function.read();
}

// clang-format off
constexpr Row ethport_table[] = {
    ioc_row<answer_ethport_attributes>("IOCMD_ETHPORT_GET_ATTR"),
    ioc_row<answer_ethport_statistics>("IOCMD_ETHPORT_GET_STATS"),
};
// clang-format on

} // namespace

std::span<const Row> ethport_rows() { return ethport_table; }

} // namespace hxasim
