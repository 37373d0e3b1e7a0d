// The head of almost every request record, and the whole record of a request that carries no data.
#pragma once

#include "hxal/records/status.h"
#include "hxal/records/types.h"

typedef struct
{
    hxa_status_t status; //  0  written by the driver
    uint16_t hxad_num;   //  4  driver instance of the IOC, written by the library
    uint16_t rsvd;       //  6
} hxa_ioctl_gen_t;
static_assert(sizeof(hxa_ioctl_gen_t) == 8, "hxa_ioctl_gen_t");
static_assert(offsetof(hxa_ioctl_gen_t, hxad_num) == 4, "hxa_ioctl_gen_t");
