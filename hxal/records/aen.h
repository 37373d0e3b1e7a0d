// Records of the asynchronous event notifications (AEN) that the drivers queue for each application.
#pragma once

#include "hxal/records/header.h"

// What the event is about, by category. Entries lie 68 bytes apart behind a 20-byte head, so nothing in here may ask for
// more than 4-byte alignment.
typedef union
{
    uint8_t bytes[40]; //  0
} hxa_aen_data_t;
static_assert(sizeof(hxa_aen_data_t) == 40, "hxa_aen_data_t");

// One event.
typedef struct
{
    uint32_t aen_category;   //  0
    uint32_t aen_type;       //  4
    hxa_aen_data_t aen_data; //  8
    hxa_timeval_t aen_tv;    // 48
    int32_t seq_num;         // 56
    int32_t hxad_num;        // 60  driver instance of the IOC that raised it
    uint32_t rsvd;           // 64
} hxa_aen_entry_t;
static_assert(sizeof(hxa_aen_entry_t) == 68, "hxa_aen_entry_t");
static_assert(offsetof(hxa_aen_entry_t, aen_tv) == 48, "hxa_aen_entry_t");

// IOCMD_AEN_SYNC. It has no common header.
typedef struct
{
    int32_t hxad_num;            //  0
    int32_t aen_count;           //  4
    uint32_t app_id;             //  8  hxa_aen_app_t
    hxa_status_t status;         // 12
    uint32_t block;              // 16
    hxa_aen_entry_t aen_list[1]; // 20
} hxa_ioctl_aen_t;
static_assert(sizeof(hxa_ioctl_aen_t) == 88, "hxa_ioctl_aen_t");
static_assert(offsetof(hxa_ioctl_aen_t, app_id) == 8, "hxa_ioctl_aen_t");
static_assert(offsetof(hxa_ioctl_aen_t, aen_list) == 20, "hxa_ioctl_aen_t");
