// Records about the physical port behind an IOC.
#pragma once

#include "hxal/records/header.h"

typedef enum
{
    HXA_PPORT_ST_UNINIT = 1,
    HXA_PPORT_ST_ENABLING_QWAIT = 2,
    HXA_PPORT_ST_ENABLING = 3,
    HXA_PPORT_ST_LINKDOWN = 4,
    HXA_PPORT_ST_LINKUP = 5,
    HXA_PPORT_ST_DISABLING_QWAIT = 6,
    HXA_PPORT_ST_DISABLING = 7,
    HXA_PPORT_ST_DISABLED = 8,
    HXA_PPORT_ST_STOPPED = 9,
    HXA_PPORT_ST_IOCDOWN = 10,
    HXA_PPORT_ST_IOCDIS = 11,
    HXA_PPORT_ST_FWMISMATCH = 12,
    HXA_PPORT_ST_PREBOOT_DISABLED = 13,
    HXA_PPORT_ST_MAX_STATE = 14,
} hxa_pport_states_t;

// Link speeds, in Gbit/s where they are a speed.
typedef enum
{
    HXA_PPORT_SPEED_UNKNOWN = 0,
    HXA_PPORT_SPEED_1GBPS = 1,
    HXA_PPORT_SPEED_2GBPS = 2,
    HXA_PPORT_SPEED_4GBPS = 4,
    HXA_PPORT_SPEED_8GBPS = 8,
    HXA_PPORT_SPEED_10GBPS = 10,
    HXA_PPORT_SPEED_AUTO = 15,
} hxa_pport_speed_t;

typedef enum
{
    HXA_PPORT_TOPOLOGY_NONE = 0,
    HXA_PPORT_TOPOLOGY_P2P = 1,
    HXA_PPORT_TOPOLOGY_LOOP = 2,
    HXA_PPORT_TOPOLOGY_AUTO = 3,
} hxa_pport_topology_t;

typedef enum
{
    HXA_PPORT_TYPE_UNKNOWN = 1,
    HXA_PPORT_TYPE_TRUNKED = 2,
    HXA_PPORT_TYPE_NPORT = 5,
    HXA_PPORT_TYPE_NLPORT = 6,
    HXA_PPORT_TYPE_LPORT = 20,
    HXA_PPORT_TYPE_P2P = 21,
    HXA_PPORT_TYPE_VPORT = 22,
} hxa_pport_type_t;

// Classes of service, a bit each.
typedef enum
{
    FC_CLASS_2 = 4,
    FC_CLASS_3 = 8,
    FC_CLASS_2_3 = 12,
} fc_cos_t;

typedef enum
{
    HXA_QOS_ONLINE = 1,
    HXA_QOS_OFFLINE = 2,
} hxa_qos_state_t;

typedef enum
{
    HXA_QOS_UNKNOWN = 0,
    HXA_QOS_HIGH = 1,
    HXA_QOS_MED = 2,
    HXA_QOS_LOW = 3,
} hxa_qos_priority_t;

// What the port is configured to be.
typedef struct
{
    uint8_t topology;      //  0  hxa_pport_topology_t
    uint8_t speed;         //  1  hxa_pport_speed_t
    uint8_t trunked;       //  2
    uint8_t qos_enabled;   //  3
    uint8_t trunk_ports;   //  4
    uint8_t cfg_hardalpa;  //  5
    uint16_t maxfrsize;    //  6  bytes
    uint8_t hardalpa;      //  8
    uint8_t rx_bbcredit;   //  9
    uint8_t tx_bbcredit;   // 10
    uint8_t ratelimit;     // 11
    uint8_t trl_def_speed; // 12  hxa_pport_speed_t
    uint8_t rsvd[3];       // 13
    uint16_t path_tov;     // 16  seconds
    uint16_t q_depth;      // 18
} hxa_pport_cfg_t;
static_assert(sizeof(hxa_pport_cfg_t) == 20, "hxa_pport_cfg_t");
static_assert(offsetof(hxa_pport_cfg_t, path_tov) == 16, "hxa_pport_cfg_t");

typedef struct
{
    wwn_t nwwn;                //   0
    wwn_t pwwn;                //   8
    wwn_t factorynwwn;         //  16
    wwn_t factorypwwn;         //  24
    uint32_t cos_supported;    //  32  fc_cos_t
    uint32_t rsvd;             //  36
    char port_symname[256];    //  40
    uint32_t speed_supported;  // 296
    uint32_t pbind_enabled;    // 300  hxa_boolean_t
    hxa_pport_cfg_t pport_cfg; // 304
    uint32_t port_state;       // 324  hxa_pport_states_t
    uint32_t speed;            // 328  hxa_pport_speed_t
    uint32_t topology;         // 332  hxa_pport_topology_t
    uint32_t beacon;           // 336  hxa_boolean_t
    uint32_t link_e2e_beacon;  // 340  hxa_boolean_t
    uint32_t plog_enabled;     // 344  hxa_boolean_t
    uint32_t pid;              // 348  FC address, bytes in wire order
    uint32_t port_type;        // 352  hxa_pport_type_t
    uint32_t loopback;         // 356
    uint32_t authfail;         // 360
    uint32_t rsvd2;            // 364
} hxa_pport_attr_t;
static_assert(sizeof(hxa_pport_attr_t) == 368, "hxa_pport_attr_t");
static_assert(offsetof(hxa_pport_attr_t, port_symname) == 40, "hxa_pport_attr_t");
static_assert(offsetof(hxa_pport_attr_t, pport_cfg) == 304, "hxa_pport_attr_t");
static_assert(offsetof(hxa_pport_attr_t, port_state) == 324, "hxa_pport_attr_t");
static_assert(offsetof(hxa_pport_attr_t, port_type) == 352, "hxa_pport_attr_t");

// IOCMD_PORT_GET_ATTR.
typedef struct
{
    hxa_status_t status;   //   0
    uint16_t hxad_num;     //   4
    uint16_t rsvd;         //   6
    hxa_pport_attr_t attr; //   8
} hxa_ioctl_port_attr_t;
static_assert(sizeof(hxa_ioctl_port_attr_t) == 376, "hxa_ioctl_port_attr_t");
static_assert(offsetof(hxa_ioctl_port_attr_t, attr) == 8, "hxa_ioctl_port_attr_t");
