// Records about the nexus between a logical port and a remote target ("itnim": initiator-target nexus of an initiator, FCP-4).
#pragma once

#include "hxal/records/header.h"

typedef enum
{
    HXA_ITNIM_OFFLINE = 0,
    HXA_ITNIM_PRLI_SEND = 1,
    HXA_ITNIM_PRLI_SENT = 2,
    HXA_ITNIM_PRLI_RETRY = 3,
    HXA_ITNIM_HCB_ONLINE = 4,
    HXA_ITNIM_ONLINE = 5,
    HXA_ITNIM_HCB_OFFLINE = 6,
    HXA_ITNIM_INITIATIOR = 7, // the driver's own spelling
} hxa_itnim_state_t;

// Latency of the commands of a nexus.
typedef struct
{
    uint32_t min;       //  0  clock ticks
    uint32_t max;       //  4  clock ticks
    uint32_t count;     //  8  of the commands measured
    uint32_t clock_res; // 12  time of one clock tick
    uint32_t avg;       // 16  from the driver: sum of the latencies in clock ticks
    uint32_t rsvd;      // 20
} hxa_itnim_latency_t;
static_assert(sizeof(hxa_itnim_latency_t) == 24, "hxa_itnim_latency_t");
static_assert(offsetof(hxa_itnim_latency_t, avg) == 16, "hxa_itnim_latency_t");

typedef struct
{
    uint32_t state;                 //  0  hxa_itnim_state_t
    uint8_t retry;                  //  4  data retransmission is supported
    uint8_t task_retry_id;          //  5  task retry identification is supported
    uint8_t rec_support;            //  6  read exchange concise is supported
    uint8_t conf_comp;              //  7  confirmed completion is supported
    hxa_itnim_latency_t io_latency; //  8
} hxa_itnim_attr_t;
static_assert(sizeof(hxa_itnim_attr_t) == 32, "hxa_itnim_attr_t");
static_assert(offsetof(hxa_itnim_attr_t, retry) == 4, "hxa_itnim_attr_t");
static_assert(offsetof(hxa_itnim_attr_t, io_latency) == 8, "hxa_itnim_attr_t");

// IOCMD_ITNIM_GET_ATTR.
typedef struct
{
    hxa_status_t status;   //  0
    uint16_t hxad_num;     //  4
    uint16_t vf_id;        //  6  virtual fabric
    wwn_t lpwwn;           //  8  of the logical port
    wwn_t rpwwn;           // 16  of the remote port
    hxa_itnim_attr_t attr; // 24
} hxa_ioctl_itnim_attr_t;
static_assert(sizeof(hxa_ioctl_itnim_attr_t) == 56, "hxa_ioctl_itnim_attr_t");
static_assert(offsetof(hxa_ioctl_itnim_attr_t, vf_id) == 6, "hxa_ioctl_itnim_attr_t");
static_assert(offsetof(hxa_ioctl_itnim_attr_t, lpwwn) == 8, "hxa_ioctl_itnim_attr_t");
static_assert(offsetof(hxa_ioctl_itnim_attr_t, rpwwn) == 16, "hxa_ioctl_itnim_attr_t");
static_assert(offsetof(hxa_ioctl_itnim_attr_t, attr) == 24, "hxa_ioctl_itnim_attr_t");

typedef struct
{
    uint32_t onlines;         //  0
    uint32_t offlines;        //  4
    uint32_t prli_sent;       //  8
    uint32_t fcxp_alloc_wait; // 12
    uint32_t prli_rsp_err;    // 16
    uint32_t prli_rsp_acc;    // 20
    uint32_t others[30];      // 24  in the driver's order
} hxa_itnim_stats_t;
static_assert(sizeof(hxa_itnim_stats_t) == 144, "hxa_itnim_stats_t");
static_assert(offsetof(hxa_itnim_stats_t, prli_rsp_acc) == 20, "hxa_itnim_stats_t");
static_assert(offsetof(hxa_itnim_stats_t, others) == 24, "hxa_itnim_stats_t");

// IOCMD_ITNIM_GET_STATS.
typedef struct
{
    hxa_status_t status;     //  0
    uint16_t hxad_num;       //  4
    uint16_t vf_id;          //  6  virtual fabric
    wwn_t lpwwn;             //  8  of the logical port
    wwn_t rpwwn;             // 16  of the remote port
    hxa_itnim_stats_t stats; // 24
} hxa_ioctl_itnim_stats_t;
static_assert(sizeof(hxa_ioctl_itnim_stats_t) == 168, "hxa_ioctl_itnim_stats_t");
static_assert(offsetof(hxa_ioctl_itnim_stats_t, stats) == 24, "hxa_ioctl_itnim_stats_t");

// IOCMD_ITNIM_RESET_STATS.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint16_t vf_id;      //  6  virtual fabric
    wwn_t lpwwn;         //  8  of the logical port
    wwn_t rpwwn;         // 16  of the remote port
} hxa_ioctl_itnim_reset_stats_t;
static_assert(sizeof(hxa_ioctl_itnim_reset_stats_t) == 24, "hxa_ioctl_itnim_reset_stats_t");
static_assert(offsetof(hxa_ioctl_itnim_reset_stats_t, rpwwn) == 16, "hxa_ioctl_itnim_reset_stats_t");
