// The counters of an FC or FCoE port that its statistics show, found by name in the library's list.
#pragma once

#include "hxal/statistics.h"
#include "runtime/types.h"

#include <cstddef>
#include <span>

namespace zmlr
{

// Offsets in bytes stand beside the counters; reserved places hold counters that are not shown.
struct fc_port_counters
{
    uint64 rsvd1;                     //   0
    uint64 tx_frames;                 //   8
    uint64 tx_words;                  //  16
    uint64 rx_frames;                 //  24
    uint64 rx_words;                  //  32
    uint64 rx_lip;                    //  40
    uint64 rx_nos;                    //  48
    uint64 errored_frames;            //  56
    uint64 dropped_frames;            //  64
    uint64 link_failures;             //  72
    uint64 loss_of_syncs;             //  80
    uint64 loss_of_signals;           //  88
    uint64 primitive_sequence_errors; //  96
    uint64 rsvd2;                     // 104
    uint64 invalid_words;             // 112
    uint64 crc_errors;                // 120
    uint64 rsvd3[22];                 // 128
};
static_assert(sizeof(fc_port_counters) == 304);
static_assert(offsetof(fc_port_counters, primitive_sequence_errors) == 96);
static_assert(offsetof(fc_port_counters, crc_errors) == 120);

struct eth_port_counters
{
    uint64 rsvd1[8];               //   0
    uint64 tx_bytes;               //  64
    uint64 tx_packets;             //  72
    uint64 rsvd2[4];               //  80
    uint64 tx_jabber;              // 112
    uint64 rsvd3[2];               // 120
    uint64 rx_bytes;               // 136
    uint64 rx_packets;             // 144
    uint64 rsvd4[4];               // 152
    uint64 rx_drops;               // 184
    uint64 rx_jabber;              // 192
    uint64 rx_fcs_errors;          // 200
    uint64 rx_alignment_errors;    // 208
    uint64 rx_frame_length_errors; // 216
    uint64 rsvd5[10];              // 224
};
static_assert(sizeof(eth_port_counters) == 304);
static_assert(offsetof(eth_port_counters, tx_jabber) == 112);
static_assert(offsetof(eth_port_counters, rx_bytes) == 136);
static_assert(offsetof(eth_port_counters, rx_drops) == 184);
static_assert(offsetof(eth_port_counters, rx_frame_length_errors) == 216);

union prov_pport_stats_u
{
    fc_port_counters fc;
    eth_port_counters eth;
};
static_assert(sizeof(prov_pport_stats_u) == 304);

// The record of a port: each counter from the first entry of the list whose name begins with the counter's; 0 where there is
// none.
prov_pport_stats_u fc_port_statistics(std::span<const hxal_stats_long_t> list);
prov_pport_stats_u eth_port_statistics(std::span<const hxal_stats_long_t> list);

} // namespace zmlr
