#include "cli/counters.h"

#include "hxal/ethport.h"
#include "hxal/fcoe.h"
#include "hxal/lport.h"
#include "hxal/port.h"
#include "hxal/statistics.h"

#include <iterator>

namespace hxa
{

namespace
{

// In the order of the counters in their records.
// clang-format off
constexpr const char* ioc_names[] = {
    "Interrupts", "IOC enables", "IOC disables", "Heartbeat failures", "IOC boots", "Statistics timeouts", "Heartbeats",
    "Disable requests", "Enable requests", "Disable replies", "Enable replies",
    "Firmware heartbeats", "Firmware configuration requests", "Firmware enable requests", "Firmware disable requests",
    "Firmware statistics requests", "Firmware clear statistics requests", "Firmware unknown requests",
    "Firmware interrupt coalescing requests",
};
static_assert(sizeof(hxa_ioc_stats_t) == std::size(ioc_names) * sizeof(std::uint32_t));

constexpr const char* network_driver_names[] = {
    "Queue stops", "Queue wakeups", "TSO IPv4", "TSO IPv6", "TSO errors", "TCP checksum offloads", "UDP checksum offloads",
    "Checksum help", "Checksum help errors", "Hardware statistics updates", "Receive schedules", "Receive completes",
    "Receive drops",
};
static_assert(sizeof(hxa_ethport_drv_stats_t) == std::size(network_driver_names) * sizeof(std::uint64_t));
// clang-format on

template <typename Pair> std::vector<Counter> counters(const std::vector<Pair>& pairs)
{
    std::vector<Counter> list;
    for (const auto& pair : pairs)
        list.push_back({pair.name, pair.value});
    return list;
}

// Reads the blocks of one port into a list.
class Reading
{
public:
    Reading(Session& session, const Port& port) : _session(session), _port(port) {}

    template <typename Pair, typename Ask> void named(const char* block, int count, const Ask& ask)
    {
        std::vector<Pair> pairs(static_cast<std::size_t>(count));
        if (accept(block, ask(pairs.data())))
            blocks.push_back({block, counters(pairs)});
    }

    void ioc(const char* block, const hxal_t* ioc)
    {
        hxa_ioc_stats_t stats{};
        if (!accept(block, hxal_ioc_get_stats(ioc, &stats)))
            return;
        std::vector<hxal_stats_t> pairs(std::size(ioc_names));
        hxal_stats_to_nv_pair(reinterpret_cast<const std::uint32_t*>(&stats), pairs.data(), ioc_names, std::ssize(ioc_names));
        blocks.push_back({block, counters(pairs)});
    }

    void network_driver(const hxal_t* ioc)
    {
        constexpr auto block = "Ethernet function";
        hxa_ethport_stats_t stats{};
        if (!accept(block, hxal_ethport_get_stats(ioc, &stats)))
            return;
        std::vector<hxal_stats_long_t> pairs(std::size(network_driver_names));
        hxal_stats_long_to_nv_pair(reinterpret_cast<const std::uint64_t*>(&stats.drv_stats), pairs.data(), network_driver_names,
                                   std::ssize(network_driver_names));
        blocks.push_back({block, counters(pairs)});
    }

    std::vector<Counter_Block> blocks;

private:
    bool accept(const char* block, hxa_status_t status)
    {
        return _session.accept(status, std::string(block) + " counters of port " + _port.name());
    }

    Session& _session;
    const Port& _port;
};

} // namespace

std::vector<Counter_Block> counters_of(Session& session, const Port& port)
{
    Reading reading(session, port);
    const auto port_counters = [&](hxal_stats_long_t* pairs) { return hxal_port_get_stats(port.ioc(), pairs); };
    if (port.fc && !port.is_converged())
        reading.named<hxal_stats_long_t>("FC port", HXAL_FC_PORT_STATS, port_counters);
    else
        reading.named<hxal_stats_long_t>("Ethernet port", HXAL_ETH_PORT_STATS, port_counters);
    if (port.is_converged())
        reading.named<hxal_stats_long_t>("FCoE", HXAL_FCOE_STATS,
                                         [&](hxal_stats_long_t* pairs) { return hxal_fcoe_get_stats(port.fc, pairs); });
    if (port.fc)
    {
        reading.named<hxal_stats_t>("logical port", HXAL_LPORT_STATS,
                                    [&](hxal_stats_t* pairs) { return hxal_lport_get_stats(port.fc, 0, port.fc->pwwn, pairs); });
        reading.ioc("FC IOC", port.fc);
    }
    if (port.ethernet)
    {
        reading.network_driver(port.ethernet);
        reading.ioc("Ethernet IOC", port.ethernet);
    }
    return std::move(reading.blocks);
}

void reset_counters(const Port& port)
{
    const auto what = "counters of port " + port.name();
    require(hxal_port_reset_stats(port.ioc()), what);
    if (port.is_converged())
        require(hxal_fcoe_reset_stats(port.fc), what);
    if (port.fc)
        require(hxal_lport_reset_stats(port.fc, 0, port.fc->pwwn), what);
    for (const auto* ioc : {port.fc, port.ethernet})
        if (ioc)
            require(hxal_ioc_reset_stats(ioc), what);
}

} // namespace hxa
