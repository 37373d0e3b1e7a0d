#include "inventory/port_statistics.h"

#include <algorithm>
#include <cstring>

namespace zmlr
{

namespace
{

// A counter of the record, and the library's name for it.
template <class Counters> struct Named_Counter
{
    uint64 Counters::*counter;
    const char* name;
};

constexpr Named_Counter<fc_port_counters> fc_names[] = {
    {&fc_port_counters::tx_frames, "Tx frames"},
    {&fc_port_counters::tx_words, "Tx words"},
    {&fc_port_counters::rx_frames, "Rx frames"},
    {&fc_port_counters::rx_words, "Rx words"},
    {&fc_port_counters::rx_lip, "Rx LIP"},
    {&fc_port_counters::rx_nos, "Rx NOS"},
    {&fc_port_counters::errored_frames, "Errored frames"},
    {&fc_port_counters::dropped_frames, "Dropped frames"},
    {&fc_port_counters::link_failures, "Link Failure (LF) count"},
    {&fc_port_counters::loss_of_syncs, "Loss of sync count"},
    {&fc_port_counters::loss_of_signals, "Loss of signal count"},
    {&fc_port_counters::primitive_sequence_errors, "Primitive sequence protocol err."},
    {&fc_port_counters::invalid_words, "Encoding err nonframe_8b10b"},
    {&fc_port_counters::crc_errors, "Rx CRC err frames"},
};

constexpr Named_Counter<eth_port_counters> eth_names[] = {
    {&eth_port_counters::tx_bytes, "Tx bytes"},
    {&eth_port_counters::tx_packets, "Tx packets"},
    {&eth_port_counters::tx_jabber, "Tx jabber"},
    {&eth_port_counters::rx_bytes, "Rx bytes"},
    {&eth_port_counters::rx_packets, "Rx packets"},
    {&eth_port_counters::rx_drops, "Rx drops"},
    {&eth_port_counters::rx_jabber, "Rx jabber"},
    {&eth_port_counters::rx_fcs_errors, "Rx FCS errors"},
    {&eth_port_counters::rx_alignment_errors, "Rx alignment errors"},
    {&eth_port_counters::rx_frame_length_errors, "Rx frame len errors"},
};

template <class Counters, std::size_t N>
void fill(Counters& counters, std::span<const hxal_stats_long_t> list, const Named_Counter<Counters> (&names)[N])
{
    for (const Named_Counter<Counters>& row : names)
    {
        const std::size_t size = std::strlen(row.name);
        const auto begins_alike = [&](const hxal_stats_long_t& entry) { return std::strncmp(entry.name, row.name, size) == 0; };
        if (const auto found = std::ranges::find_if(list, begins_alike); found != list.end())
            counters.*row.counter = found->value;
    }
}

} // namespace

prov_pport_stats_u fc_port_statistics(std::span<const hxal_stats_long_t> list)
{
    prov_pport_stats_u statistics{.fc = {}};
    fill(statistics.fc, list, fc_names);
    return statistics;
}

prov_pport_stats_u eth_port_statistics(std::span<const hxal_stats_long_t> list)
{
    prov_pport_stats_u statistics{.eth = {}};
    fill(statistics.eth, list, eth_names);
    return statistics;
}

} // namespace zmlr
