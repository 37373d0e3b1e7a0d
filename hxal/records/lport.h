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
