// Requests that configure the physical port behind an IOC.
#pragma once

#include "hxal/records/port.h"

// IOCMD_PORT_CFG_TOPO.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint16_t rsvd;       //  6
    uint32_t topo;       //  8  hxa_pport_topology_t
    uint32_t rsvd1;      // 12
} hxa_ioctl_port_cfg_topo_t;
static_assert(sizeof(hxa_ioctl_port_cfg_topo_t) == 16, "hxa_ioctl_port_cfg_topo_t");
static_assert(offsetof(hxa_ioctl_port_cfg_topo_t, topo) == 8, "hxa_ioctl_port_cfg_topo_t");

// IOCMD_PORT_CFG_SPEED.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint16_t rsvd;       //  6
    uint32_t speed;      //  8  hxa_pport_speed_t
    uint32_t rsvd1;      // 12
} hxa_ioctl_port_cfg_speed_t;
static_assert(sizeof(hxa_ioctl_port_cfg_speed_t) == 16, "hxa_ioctl_port_cfg_speed_t");
static_assert(offsetof(hxa_ioctl_port_cfg_speed_t, speed) == 8, "hxa_ioctl_port_cfg_speed_t");

// IOCMD_PORT_CFG_ALPA and IOCMD_PORT_CLR_ALPA.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint16_t rsvd;       //  6
    uint8_t alpa;        //  8  arbitrated loop physical address, FC-AL-2
    uint8_t rsvd1[7];    //  9
} hxa_ioctl_port_alpa_t;
static_assert(sizeof(hxa_ioctl_port_alpa_t) == 16, "hxa_ioctl_port_alpa_t");
static_assert(offsetof(hxa_ioctl_port_alpa_t, alpa) == 8, "hxa_ioctl_port_alpa_t");

// IOCMD_PORT_CFG_MAXFRSZ.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint16_t maxfrsize;  //  6  bytes
} hxa_ioctl_port_cfg_maxfrsize_t;
static_assert(sizeof(hxa_ioctl_port_cfg_maxfrsize_t) == 8, "hxa_ioctl_port_cfg_maxfrsize_t");
static_assert(offsetof(hxa_ioctl_port_cfg_maxfrsize_t, maxfrsize) == 6, "hxa_ioctl_port_cfg_maxfrsize_t");

// IOCMD_PORT_TRUNK_ENABLE and IOCMD_PORT_TRUNK_DISABLE.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint8_t pp_bmap;     //  6  ports to trunk, a bit each
    uint8_t rsvd;        //  7
} hxa_ioctl_port_trunk_t;
static_assert(sizeof(hxa_ioctl_port_trunk_t) == 8, "hxa_ioctl_port_trunk_t");
static_assert(offsetof(hxa_ioctl_port_trunk_t, pp_bmap) == 6, "hxa_ioctl_port_trunk_t");

// What the port tells others that ask who it is: the general topology discovery format of RNID (request node identification
// data, FC-LS). It travels in 44 bytes everywhere, which is no multiple of the alignment of its WWN.
#pragma pack(push, 4)
typedef struct
{
    wwn_t wwn;                       //  0
    uint32_t unittype;               //  8  associated type
    uint32_t portid;                 // 12  physical port number
    uint32_t attached_nodes_num;     // 16
    uint16_t ip_version;             // 20
    uint16_t udp_port;               // 22
    uint8_t ipaddr[16];              // 24
    uint16_t rsvd;                   // 40
    uint16_t topologydiscoveryflags; // 42
} hxa_pport_rnid_t;
#pragma pack(pop)
static_assert(sizeof(hxa_pport_rnid_t) == 44, "hxa_pport_rnid_t");
static_assert(offsetof(hxa_pport_rnid_t, ipaddr) == 24, "hxa_pport_rnid_t");
static_assert(offsetof(hxa_pport_rnid_t, topologydiscoveryflags) == 42, "hxa_pport_rnid_t");

// IOCMD_PORT_CFG_RNID and IOCMD_PORT_GET_RNID.
typedef struct
{
    hxa_status_t status;   //  0
    uint16_t hxad_num;     //  4
    uint16_t rsvd;         //  6
    hxa_pport_rnid_t info; //  8
    uint32_t rsvd1;        // 52
} hxa_ioctl_port_rnid_t;
static_assert(sizeof(hxa_ioctl_port_rnid_t) == 56, "hxa_ioctl_port_rnid_t");
static_assert(offsetof(hxa_ioctl_port_rnid_t, info) == 8, "hxa_ioctl_port_rnid_t");
static_assert(offsetof(hxa_ioctl_port_rnid_t, rsvd1) == 52, "hxa_ioctl_port_rnid_t");
