// Records about the Fibre Channel side of an I/O controller ("IOC-FC"): configuration, interrupt moderation, counters.
#pragma once

#include "hxal/records/ioc.h"

// How the firmware is configured: how many of each resource it has.
typedef struct
{
    uint16_t num_fabrics;    //  0
    uint16_t num_lports;     //  2
    uint16_t num_rports;     //  4
    uint16_t num_ioim_reqs;  //  6
    uint16_t num_tskim_reqs; //  8
    uint16_t num_iotm_reqs;  // 10
    uint16_t num_tsktm_reqs; // 12
    uint16_t num_fcxp_reqs;  // 14
    uint16_t num_uf_bufs;    // 16
    uint8_t num_cqs;         // 18
    uint8_t fw_tick_res;     // 19  clock resolution
    uint8_t rsvd[4];         // 20
} hxa_iocfc_fwcfg_t;
static_assert(sizeof(hxa_iocfc_fwcfg_t) == 24, "hxa_iocfc_fwcfg_t");
static_assert(offsetof(hxa_iocfc_fwcfg_t, num_cqs) == 18, "hxa_iocfc_fwcfg_t");

// How the driver is configured.
typedef struct
{
    uint16_t num_reqq_elems; //  0
    uint16_t num_rspq_elems; //  2
    uint16_t num_sgpgs;      //  4
    uint16_t num_sboot_tgts; //  6
    uint16_t num_sboot_luns; //  8
    uint16_t ioc_recover;    // 10
    uint16_t min_cfg;        // 12
    uint16_t path_tov;       // 14  seconds
    uint32_t delay_comp;     // 16  hxa_boolean_t
    uint32_t rsvd;           // 20
} hxa_iocfc_drvcfg_t;
static_assert(sizeof(hxa_iocfc_drvcfg_t) == 24, "hxa_iocfc_drvcfg_t");
static_assert(offsetof(hxa_iocfc_drvcfg_t, delay_comp) == 16, "hxa_iocfc_drvcfg_t");

// Interrupt moderation.
typedef struct
{
    uint32_t coalesce; // 0  hxa_boolean_t
    uint16_t latency;  // 4
    uint16_t delay;    // 6
} hxa_iocfc_intr_attr_t;
static_assert(sizeof(hxa_iocfc_intr_attr_t) == 8, "hxa_iocfc_intr_attr_t");

typedef struct
{
    hxa_iocfc_fwcfg_t fwcfg;         //  0
    hxa_iocfc_drvcfg_t drvcfg;       // 24
    hxa_iocfc_intr_attr_t intr_attr; // 48
} hxa_iocfc_attr_t;
static_assert(sizeof(hxa_iocfc_attr_t) == 56, "hxa_iocfc_attr_t");
static_assert(offsetof(hxa_iocfc_attr_t, intr_attr) == 48, "hxa_iocfc_attr_t");

// IOCMD_IOCFC_GET_ATTR.
typedef struct
{
    hxa_status_t status;   //  0
    uint16_t hxad_num;     //  4
    uint16_t rsvd;         //  6
    hxa_iocfc_attr_t attr; //  8
} hxa_ioctl_iocfc_attr_t;
static_assert(sizeof(hxa_ioctl_iocfc_attr_t) == 64, "hxa_ioctl_iocfc_attr_t");
static_assert(offsetof(hxa_ioctl_iocfc_attr_t, attr) == 8, "hxa_ioctl_iocfc_attr_t");

// IOCMD_IOCFC_SET_INTR.
typedef struct
{
    hxa_status_t status;        //  0
    uint16_t hxad_num;          //  4
    uint16_t rsvd;              //  6
    hxa_iocfc_intr_attr_t attr; //  8
} hxa_ioctl_iocfc_intr_t;
static_assert(sizeof(hxa_ioctl_iocfc_intr_t) == 16, "hxa_ioctl_iocfc_intr_t");
static_assert(offsetof(hxa_ioctl_iocfc_intr_t, attr) == 8, "hxa_ioctl_iocfc_intr_t");

// What the firmware counts of SCSI commands; `more` goes on in the firmware's own order.
typedef struct
{
    uint32_t host_abort;       //  0
    uint32_t host_cleanup;     //  4
    uint32_t fw_io_timeout;    //  8
    uint32_t fw_frm_parse;     // 12
    uint32_t fw_frm_data;      // 16
    uint32_t fw_frm_rsp;       // 20
    uint32_t fw_frm_xfer_rdy;  // 24
    uint32_t fw_frm_bls_acc;   // 28
    uint32_t fw_frm_tgt_abort; // 32
    uint32_t fw_frm_unknown;   // 36
    uint32_t fw_data_dma;      // 40
    uint32_t fw_frm_drop;      // 44
    uint32_t rec_timeout;      // 48
    uint32_t error_rec;        // 52
    uint32_t wait_for_si;      // 56
    uint32_t rec_rsp_inval;    // 60
    uint32_t more[36];         // 64
} hxa_fw_io_stats_t;
static_assert(sizeof(hxa_fw_io_stats_t) == 208, "hxa_fw_io_stats_t");
static_assert(offsetof(hxa_fw_io_stats_t, more) == 64, "hxa_fw_io_stats_t");

typedef struct
{
    hxa_fw_ioc_stats_t ioc_stats; //   0
    hxa_fw_io_stats_t io_stats;   //  32
    uint32_t port_stats[56];      // 240  of the port, in the firmware's own order
} hxa_iocfc_stats_t;
static_assert(sizeof(hxa_iocfc_stats_t) == 464, "hxa_iocfc_stats_t");
static_assert(offsetof(hxa_iocfc_stats_t, io_stats) == 32, "hxa_iocfc_stats_t");
static_assert(offsetof(hxa_iocfc_stats_t, port_stats) == 240, "hxa_iocfc_stats_t");

// IOCMD_IOCFC_GET_STATS.
typedef struct
{
    hxa_status_t status;     //  0
    uint16_t hxad_num;       //  4
    uint16_t rsvd;           //  6
    hxa_iocfc_stats_t stats; //  8
} hxa_ioctl_iocfc_stats_t;
static_assert(sizeof(hxa_ioctl_iocfc_stats_t) == 472, "hxa_ioctl_iocfc_stats_t");
static_assert(offsetof(hxa_ioctl_iocfc_stats_t, stats) == 8, "hxa_ioctl_iocfc_stats_t");
