// Statistics of the physical port: what its FC or its Ethernet hardware counts.
#pragma once

#include "hxal/records/header.h"

// Of an FC port: the counters of the FC-FS-2 link services and of the 8b/10b code. `secs_reset` is in seconds.
typedef struct
{
    uint64_t secs_reset;         //   0
    uint64_t tx_frames;          //   8
    uint64_t tx_words;           //  16
    uint64_t tx_lip;             //  24
    uint64_t tx_nos;             //  32
    uint64_t tx_ols;             //  40
    uint64_t tx_lr;              //  48
    uint64_t tx_lrr;             //  56
    uint64_t rx_frames;          //  64
    uint64_t rx_words;           //  72
    uint64_t lip_count;          //  80
    uint64_t nos_count;          //  88
    uint64_t ols_count;          //  96
    uint64_t lr_count;           // 104
    uint64_t lrr_count;          // 112
    uint64_t invalid_crcs;       // 120
    uint64_t invalid_crc_gd_eof; // 128
    uint64_t undersized_frm;     // 136
    uint64_t oversized_frm;      // 144
    uint64_t bad_eof_frm;        // 152
    uint64_t error_frames;       // 160
    uint64_t dropped_frames;     // 168
    uint64_t link_failures;      // 176
    uint64_t loss_of_syncs;      // 184
    uint64_t loss_of_signals;    // 192
    uint64_t primseq_errs;       // 200
    uint64_t bad_os_count;       // 208
    uint64_t err_enc_out;        // 216
    uint64_t err_enc;            // 224
} hxa_pport_fc_stats_t;
static_assert(sizeof(hxa_pport_fc_stats_t) == 232, "hxa_pport_fc_stats_t");
static_assert(offsetof(hxa_pport_fc_stats_t, rx_frames) == 64, "hxa_pport_fc_stats_t");
static_assert(offsetof(hxa_pport_fc_stats_t, err_enc) == 224, "hxa_pport_fc_stats_t");

// Of an Ethernet port. `secs_reset` is in seconds; the frames are counted by their size in bytes.
typedef struct
{
    uint64_t secs_reset;            //   0
    uint64_t frame_64;              //   8
    uint64_t frame_65_127;          //  16
    uint64_t frame_128_255;         //  24
    uint64_t frame_256_511;         //  32
    uint64_t frame_512_1023;        //  40
    uint64_t frame_1024_1518;       //  48
    uint64_t frame_1519_1522;       //  56
    uint64_t tx_bytes;              //  64
    uint64_t tx_packets;            //  72
    uint64_t tx_mcast_packets;      //  80
    uint64_t tx_bcast_packets;      //  88
    uint64_t tx_control_frame;      //  96
    uint64_t tx_drop;               // 104
    uint64_t tx_jabber;             // 112
    uint64_t tx_fcs_error;          // 120
    uint64_t tx_fragments;          // 128
    uint64_t rx_bytes;              // 136
    uint64_t rx_packets;            // 144
    uint64_t rx_mcast_packets;      // 152
    uint64_t rx_bcast_packets;      // 160
    uint64_t rx_control_frames;     // 168
    uint64_t rx_unknown_opcode;     // 176
    uint64_t rx_drop;               // 184
    uint64_t rx_jabber;             // 192
    uint64_t rx_fcs_error;          // 200
    uint64_t rx_alignment_error;    // 208
    uint64_t rx_frame_length_error; // 216
    uint64_t rx_code_error;         // 224
    uint64_t rx_fragments;          // 232
    uint64_t rx_pause;              // 240
    uint64_t rx_zero_pause;         // 248
    uint64_t tx_pause;              // 256
    uint64_t tx_zero_pause;         // 264
    uint64_t rx_fcoe_pause;         // 272
    uint64_t rx_fcoe_zero_pause;    // 280
    uint64_t tx_fcoe_pause;         // 288
    uint64_t tx_fcoe_zero_pause;    // 296
} hxa_pport_eth_stats_t;
static_assert(sizeof(hxa_pport_eth_stats_t) == 304, "hxa_pport_eth_stats_t");
static_assert(offsetof(hxa_pport_eth_stats_t, rx_bytes) == 136, "hxa_pport_eth_stats_t");
static_assert(offsetof(hxa_pport_eth_stats_t, tx_fcoe_zero_pause) == 296, "hxa_pport_eth_stats_t");

typedef union
{
    hxa_pport_fc_stats_t fc;
    hxa_pport_eth_stats_t eth;
} hxa_pport_stats_t;
static_assert(sizeof(hxa_pport_stats_t) == 304, "hxa_pport_stats_t");

// IOCMD_PORT_GET_STATS. The driver writes the counters to the buffer, not into the record.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint16_t rsvd;       //  6
    uint32_t buf_size;   //  8  bytes at buf_ptr
    uint32_t rsvd1;      // 12
    uint64_t buf_ptr;    // 16  address of a hxa_pport_stats_t of the sender, zero-extended
} hxa_ioctl_port_stats_t;
static_assert(sizeof(hxa_ioctl_port_stats_t) == 24, "hxa_ioctl_port_stats_t");
static_assert(offsetof(hxa_ioctl_port_stats_t, buf_size) == 8, "hxa_ioctl_port_stats_t");
static_assert(offsetof(hxa_ioctl_port_stats_t, buf_ptr) == 16, "hxa_ioctl_port_stats_t");
