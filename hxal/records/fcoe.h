// Statistics of the FC function behind a port: FCoE (FC-BB-5) on a converged port, quality of service on an FC port.
#pragma once

#include "hxal/records/header.h"

// FCoE counters: link, FIP (FCoE initialization protocol), frames sent and received. `secs_reset` is in seconds.
typedef struct
{
    uint64_t secs_reset;            //   0
    uint64_t cee_linkups;           //   8
    uint64_t cee_linkdns;           //  16
    uint64_t fip_linkups;           //  24
    uint64_t fip_linkdns;           //  32
    uint64_t fip_fails;             //  40
    uint64_t mac_invalids;          //  48
    uint64_t vlan_req;              //  56
    uint64_t vlan_notify;           //  64
    uint64_t vlan_err;              //  72
    uint64_t vlan_timeouts;         //  80
    uint64_t vlan_invalids;         //  88
    uint64_t disc_req;              //  96
    uint64_t disc_rsp;              // 104
    uint64_t disc_err;              // 112
    uint64_t disc_unsol;            // 120
    uint64_t disc_timeouts;         // 128
    uint64_t disc_fcf_unavail;      // 136
    uint64_t linksvc_unsupp;        // 144
    uint64_t linksvc_err;           // 152
    uint64_t logo_req;              // 160
    uint64_t clrvlink_req;          // 168
    uint64_t op_unsupp;             // 176
    uint64_t untagged;              // 184
    uint64_t txf_ucast;             // 192
    uint64_t txf_ucast_vlan;        // 200
    uint64_t txf_ucast_octets;      // 208
    uint64_t txf_mcast;             // 216
    uint64_t txf_mcast_vlan;        // 224
    uint64_t txf_mcast_octets;      // 232
    uint64_t txf_bcast;             // 240
    uint64_t txf_bcast_vlan;        // 248
    uint64_t txf_bcast_octets;      // 256
    uint64_t txf_timeout;           // 264
    uint64_t txf_parity_errors;     // 272
    uint64_t txf_fid_parity_errors; // 280
    uint64_t rxf_ucast_octets;      // 288
    uint64_t rxf_ucast;             // 296
    uint64_t rxf_ucast_vlan;        // 304
    uint64_t rxf_mcast_octets;      // 312
    uint64_t rxf_mcast;             // 320
    uint64_t rxf_mcast_vlan;        // 328
    uint64_t rxf_bcast_octets;      // 336
    uint64_t rxf_bcast;             // 344
    uint64_t rxf_bcast_vlan;        // 352
} hxa_fcoe_stats_t;
static_assert(sizeof(hxa_fcoe_stats_t) == 360, "hxa_fcoe_stats_t");
static_assert(offsetof(hxa_fcoe_stats_t, txf_ucast) == 192, "hxa_fcoe_stats_t");
static_assert(offsetof(hxa_fcoe_stats_t, rxf_bcast_vlan) == 352, "hxa_fcoe_stats_t");

typedef struct
{
    uint32_t flogi_sent;      //  0
    uint32_t flogi_acc_recvd; //  4
    uint32_t flogi_rjt_recvd; //  8
    uint32_t flogi_retries;   // 12
    uint32_t elp_recvd;       // 16
    uint32_t elp_accepted;    // 20
    uint32_t elp_rejected;    // 24
    uint32_t elp_dropped;     // 28
    uint32_t qos_rscn_recvd;  // 32
    uint32_t rsvd;            // 36
} hxa_fcqos_stats_t;
static_assert(sizeof(hxa_fcqos_stats_t) == 40, "hxa_fcqos_stats_t");
static_assert(offsetof(hxa_fcqos_stats_t, rsvd) == 36, "hxa_fcqos_stats_t");

typedef union
{
    hxa_fcoe_stats_t fcoe;
    hxa_fcqos_stats_t fcqos;
} hxa_fcport_stats_t;
static_assert(sizeof(hxa_fcport_stats_t) == 360, "hxa_fcport_stats_t");

// IOCMD_FCOE_GET_STATS.
typedef struct
{
    hxa_status_t status;      //  0
    uint16_t hxad_num;        //  4
    uint16_t rsvd;            //  6
    hxa_fcport_stats_t stats; //  8
} hxa_ioctl_fcport_stats_t;
static_assert(sizeof(hxa_ioctl_fcport_stats_t) == 368, "hxa_ioctl_fcport_stats_t");
static_assert(offsetof(hxa_ioctl_fcport_stats_t, stats) == 8, "hxa_ioctl_fcport_stats_t");
