// Records about the logical FC ports that log into the fabric on a physical port: the base port and the virtual ports
// (N_Port_ID virtualization, FC-LS). A request names one by its port WWN and its virtual fabric.
#pragma once

#include "hxal/records/header.h"

typedef enum
{
    HXA_PORT_UNINIT = 0,
    HXA_PORT_FDISC = 1,
    HXA_PORT_ONLINE = 2,
    HXA_PORT_OFFLINE = 3,
} hxa_port_state_t;

// What a logical port does, a bit each.
typedef enum
{
    HXA_PORT_ROLE_FCP_IM = 1,   // initiator
    HXA_PORT_ROLE_FCP_TM = 2,   // target
    HXA_PORT_ROLE_FCP_IPFC = 4, // IP over FC
    HXA_PORT_ROLE_FCP_MAX = 5,  // end marker
} hxa_port_role_t;

// What a logical port is configured to be.
typedef struct
{
    wwn_t pwwn;          //   0
    wwn_t nwwn;          //   8
    char sym_name[128];  //  16
    uint32_t preboot_vp; // 144  hxa_boolean_t: made before the system started
    uint32_t roles;      // 148  hxa_port_role_t
    uint8_t tag[16];     // 152  of the creator
} hxa_port_cfg_t;
static_assert(sizeof(hxa_port_cfg_t) == 168, "hxa_port_cfg_t");
static_assert(offsetof(hxa_port_cfg_t, preboot_vp) == 144, "hxa_port_cfg_t");
static_assert(offsetof(hxa_port_cfg_t, tag) == 152, "hxa_port_cfg_t");

typedef struct
{
    uint32_t state;             //   0  hxa_port_state_t
    uint32_t pid;               //   4  FC address, bytes in wire order; 0 while it has none
    hxa_port_cfg_t port_cfg;    //   8
    uint32_t port_type;         // 176  hxa_pport_type_t
    uint32_t loopback;          // 180
    wwn_t fabric_name;          // 184
    uint8_t fabric_ip_addr[16]; // 192
    mac_t fpma_mac;             // 208  fabric-provided MAC address, FC-BB-5
    uint16_t authfail;          // 214
} hxa_port_attr_t;
static_assert(sizeof(hxa_port_attr_t) == 216, "hxa_port_attr_t");
static_assert(offsetof(hxa_port_attr_t, port_cfg) == 8, "hxa_port_attr_t");
static_assert(offsetof(hxa_port_attr_t, port_type) == 176, "hxa_port_attr_t");
static_assert(offsetof(hxa_port_attr_t, fabric_name) == 184, "hxa_port_attr_t");
static_assert(offsetof(hxa_port_attr_t, fpma_mac) == 208, "hxa_port_attr_t");
static_assert(offsetof(hxa_port_attr_t, authfail) == 214, "hxa_port_attr_t");

// IOCMD_LPORT_GET_ATTR.
typedef struct
{
    hxa_status_t status;  //  0
    uint16_t hxad_num;    //  4
    uint16_t vf_id;       //  6  virtual fabric
    wwn_t pwwn;           //  8  of the logical port
    hxa_port_attr_t attr; // 16
} hxa_ioctl_lport_attr_t;
static_assert(sizeof(hxa_ioctl_lport_attr_t) == 232, "hxa_ioctl_lport_attr_t");
static_assert(offsetof(hxa_ioctl_lport_attr_t, vf_id) == 6, "hxa_ioctl_lport_attr_t");
static_assert(offsetof(hxa_ioctl_lport_attr_t, pwwn) == 8, "hxa_ioctl_lport_attr_t");
static_assert(offsetof(hxa_ioctl_lport_attr_t, attr) == 16, "hxa_ioctl_lport_attr_t");

// Requests of a logical port to the name server and the management server of the fabric (FC-GS), by their outcome.
typedef struct
{
    uint32_t ns_plogi_sent;        //   0
    uint32_t ns_plogi_rsp_err;     //   4
    uint32_t ns_plogi_acc_err;     //   8
    uint32_t ns_plogi_accepts;     //  12
    uint32_t ns_rejects;           //  16
    uint32_t ns_plogi_unknown_rsp; //  20
    uint32_t ns_plogi_alloc_wait;  //  24
    uint32_t ns_retries;           //  28
    uint32_t ns_timeouts;          //  32
    uint32_t ns_rspnid_sent;       //  36
    uint32_t ns_rspnid_accepts;    //  40
    uint32_t ns_rspnid_rsp_err;    //  44
    uint32_t ns_rspnid_rejects;    //  48
    uint32_t ns_rspnid_alloc_wait; //  52
    uint32_t ns_rftid_sent;        //  56
    uint32_t ns_rftid_accepts;     //  60
    uint32_t ns_rftid_rsp_err;     //  64
    uint32_t ns_rftid_rejects;     //  68
    uint32_t ns_rftid_alloc_wait;  //  72
    uint32_t ns_rffid_sent;        //  76
    uint32_t ns_rffid_accepts;     //  80
    uint32_t ns_rffid_rsp_err;     //  84
    uint32_t ns_rffid_rejects;     //  88
    uint32_t ns_rffid_alloc_wait;  //  92
    uint32_t ns_gidft_sent;        //  96
    uint32_t ns_gidft_accepts;     // 100
    uint32_t ns_gidft_rsp_err;     // 104
    uint32_t ns_gidft_rejects;     // 108
    uint32_t ns_gidft_unknown_rsp; // 112
    uint32_t ns_gidft_alloc_wait;  // 116
    uint32_t ms_retries;           // 120
    uint32_t ms_timeouts;          // 124
    uint32_t ms_plogi_sent;        // 128
    uint32_t ms_plogi_rsp_err;     // 132
    uint32_t ms_plogi_acc_err;     // 136
    uint32_t ms_plogi_accepts;     // 140
    uint32_t ms_rejects;           // 144
    uint32_t ms_plogi_unknown_rsp; // 148
    uint32_t ms_plogi_alloc_wait;  // 152
    uint32_t num_rscn;             // 156
    uint32_t num_portid_rscn;      // 160
    uint32_t uf_recvs;             // 164
    uint32_t uf_recv_drops;        // 168
    uint32_t rsvd;                 // 172
} hxa_lport_stats_t;
static_assert(sizeof(hxa_lport_stats_t) == 176, "hxa_lport_stats_t");
static_assert(offsetof(hxa_lport_stats_t, num_rscn) == 156, "hxa_lport_stats_t");
static_assert(offsetof(hxa_lport_stats_t, rsvd) == 172, "hxa_lport_stats_t");

// IOCMD_LPORT_GET_STATS.
typedef struct
{
    hxa_status_t status;     //  0
    uint16_t hxad_num;       //  4
    uint16_t vf_id;          //  6  virtual fabric
    wwn_t pwwn;              //  8  of the logical port
    hxa_lport_stats_t stats; // 16
} hxa_ioctl_lport_stats_t;
static_assert(sizeof(hxa_ioctl_lport_stats_t) == 192, "hxa_ioctl_lport_stats_t");
static_assert(offsetof(hxa_ioctl_lport_stats_t, stats) == 16, "hxa_ioctl_lport_stats_t");

// IOCMD_LPORT_RESET_STATS.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint16_t vf_id;      //  6  virtual fabric
    wwn_t pwwn;          //  8  of the logical port
} hxa_ioctl_lport_reset_stats_t;
static_assert(sizeof(hxa_ioctl_lport_reset_stats_t) == 16, "hxa_ioctl_lport_reset_stats_t");
static_assert(offsetof(hxa_ioctl_lport_reset_stats_t, pwwn) == 8, "hxa_ioctl_lport_reset_stats_t");

// IOCMD_LPORT_GET_RPORTS. The driver writes the port WWNs of the remote ports to the array.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint16_t vf_id;      //  6  virtual fabric
    wwn_t pwwn;          //  8  of the logical port
    uint64_t rbuf_ptr;   // 16  address of an array of WWNs of the sender, zero-extended
    uint32_t nrports;    // 24  in: room, in WWNs; out: WWNs written
    uint32_t rsvd;       // 28
} hxa_ioctl_lport_get_rports_t;
static_assert(sizeof(hxa_ioctl_lport_get_rports_t) == 32, "hxa_ioctl_lport_get_rports_t");
static_assert(offsetof(hxa_ioctl_lport_get_rports_t, rbuf_ptr) == 16, "hxa_ioctl_lport_get_rports_t");
static_assert(offsetof(hxa_ioctl_lport_get_rports_t, nrports) == 24, "hxa_ioctl_lport_get_rports_t");
