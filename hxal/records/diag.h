// Records of the diagnostic requests.
#pragma once

#include "hxal/records/header.h"

// IOCMD_DIAG_LB_STAT. The status tells whether a loopback test holds the port.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint16_t rsvd;       //  6
} hxa_ioctl_diag_lb_stat_t;
static_assert(sizeof(hxa_ioctl_diag_lb_stat_t) == 8, "hxa_ioctl_diag_lb_stat_t");
