// The record of SCSI pass-through.
#pragma once

#include "hxal/records/header.h"

// A command descriptor block, SPC-3; a shorter command leaves the rest 0.
typedef struct
{
    uint8_t scsi_cdb[16]; //  0
} scsi_cdb_t;
static_assert(sizeof(scsi_cdb_t) == 16, "scsi_cdb_t");

// IOCMD_SCSI_CMND. Data and sense lie in buffers of the sender.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint16_t vf_id;      //  6  virtual fabric
    wwn_t lpwwn;         //  8  of the logical port
    wwn_t rpwwn;         // 16  of the remote port
    lun_t lun;           // 24
    scsi_cdb_t cdb;      // 32
    int32_t write;       // 48  0: data comes from the target
    uint32_t iosz;       // 52  bytes at iobuf_ptr
    uint8_t rsvd1[3];    // 56
    uint8_t scsi_status; // 59  out
    uint32_t snssz;      // 60  in: room for sense data, bytes; out: their length
    uint64_t iobuf_ptr;  // 64  addresses of the sender, zero-extended
    uint64_t snsbuf_pt;  // 72
} hxa_ioctl_scsi_t;
static_assert(sizeof(hxa_ioctl_scsi_t) == 80, "hxa_ioctl_scsi_t");
static_assert(offsetof(hxa_ioctl_scsi_t, rpwwn) == 16, "hxa_ioctl_scsi_t");
static_assert(offsetof(hxa_ioctl_scsi_t, lun) == 24, "hxa_ioctl_scsi_t");
static_assert(offsetof(hxa_ioctl_scsi_t, cdb) == 32, "hxa_ioctl_scsi_t");
static_assert(offsetof(hxa_ioctl_scsi_t, write) == 48, "hxa_ioctl_scsi_t");
static_assert(offsetof(hxa_ioctl_scsi_t, scsi_status) == 59, "hxa_ioctl_scsi_t");
static_assert(offsetof(hxa_ioctl_scsi_t, snssz) == 60, "hxa_ioctl_scsi_t");
static_assert(offsetof(hxa_ioctl_scsi_t, iobuf_ptr) == 64, "hxa_ioctl_scsi_t");
static_assert(offsetof(hxa_ioctl_scsi_t, snsbuf_pt) == 72, "hxa_ioctl_scsi_t");
