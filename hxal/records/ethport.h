// Records about the Ethernet side of a converged port.
#pragma once

#include "hxal/records/header.h"

typedef enum
{
    HXA_ETHPORT_CEE_LINKDOWN = 1,
    HXA_ETHPORT_CEE_LINKUP = 2,
} hxa_ethport_cee_state_t;

typedef struct
{
    uint32_t mtu;             //  0  largest payload of a frame, bytes
    uint32_t speed_supported; //  4  hxa_pport_speed_t
    uint32_t port_state;      //  8  hxa_pport_states_t
    uint32_t speed;           // 12  hxa_pport_speed_t
} hxa_ethport_attr_t;
static_assert(sizeof(hxa_ethport_attr_t) == 16, "hxa_ethport_attr_t");
static_assert(offsetof(hxa_ethport_attr_t, speed) == 12, "hxa_ethport_attr_t");

// IOCMD_ETHPORT_GET_ATTR.
typedef struct
{
    hxa_status_t status;     //  0
    uint16_t hxad_num;       //  4
    uint16_t rsvd;           //  6
    hxa_ethport_attr_t attr; //  8
} hxa_ioctl_ethport_attr_t;
static_assert(sizeof(hxa_ioctl_ethport_attr_t) == 24, "hxa_ioctl_ethport_attr_t");
static_assert(offsetof(hxa_ioctl_ethport_attr_t, attr) == 8, "hxa_ioctl_ethport_attr_t");

// What the network driver counts.
typedef struct
{
    uint64_t netif_queue_stop;   //  0
    uint64_t netif_queue_wakeup; //  8
    uint64_t tso4;               // 16
    uint64_t tso6;               // 24
    uint64_t tso_err;            // 32
    uint64_t tcpcsum_offload;    // 40
    uint64_t udpcsum_offload;    // 48
    uint64_t csum_help;          // 56
    uint64_t csum_help_err;      // 64
    uint64_t hw_stats_updates;   // 72
    uint64_t netif_rx_schedule;  // 80
    uint64_t netif_rx_complete;  // 88
    uint64_t netif_rx_dropped;   // 96
} hxa_ethport_drv_stats_t;
static_assert(sizeof(hxa_ethport_drv_stats_t) == 104, "hxa_ethport_drv_stats_t");
static_assert(offsetof(hxa_ethport_drv_stats_t, netif_rx_dropped) == 96, "hxa_ethport_drv_stats_t");

typedef struct
{
    uint64_t txf_stats[12];            //   0  transmit function, in the driver's order
    uint64_t rxf_stats[10];            //  96  receive function, in the driver's order
    hxa_ethport_drv_stats_t drv_stats; // 176
} hxa_ethport_stats_t;
static_assert(sizeof(hxa_ethport_stats_t) == 280, "hxa_ethport_stats_t");
static_assert(offsetof(hxa_ethport_stats_t, rxf_stats) == 96, "hxa_ethport_stats_t");
static_assert(offsetof(hxa_ethport_stats_t, drv_stats) == 176, "hxa_ethport_stats_t");

// IOCMD_ETHPORT_GET_STATS.
typedef struct
{
    hxa_status_t status;       //  0
    uint16_t hxad_num;         //  4
    uint16_t rsvd;             //  6
    hxa_ethport_stats_t stats; //  8
} hxa_ioctl_ethport_stats_t;
static_assert(sizeof(hxa_ioctl_ethport_stats_t) == 288, "hxa_ioctl_ethport_stats_t");
static_assert(offsetof(hxa_ioctl_ethport_stats_t, stats) == 8, "hxa_ioctl_ethport_stats_t");
