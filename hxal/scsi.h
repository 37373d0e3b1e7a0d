// SCSI pass-through: one command to a logical unit behind a remote port, as SAM-3 has it.
//
// A unit is named by the logical port (`lpwwn`, `vf_id`; see hxal/lport.h), the remote port (`rpwwn`; see hxal/rport.h) and
// the LUN, 8 bytes in the order of REPORT LUNS. The library sends the command and hands back what the driver says; what SCSI
// status and sense data mean is the caller's to tell: a command that the unit refuses is HXA_STATUS_OK with a SCSI status.
#pragma once

#include "hxal/ioc.h"
#include "hxal/records/scsi.h"

#ifdef __cplusplus
extern "C"
{
#endif

    // One request: sends the command in `cdb`, with `iosz` bytes of data from `iobuf` (`write` not 0) or to it (0). The driver
    // fills data and sense buffer directly, while the call lasts.
    //   `iobuf`        may be null when `iosz` is 0
    //   `scsi_status`  the unit's status byte (SAM-3); may be null
    //   `snssz`        in: room in `snsbuf`, in bytes; out: the length that the driver gives: do not trust it beyond the room.
    //                  May be null: no sense data then. `snsbuf` may be null when there is no room.
    // `*scsi_status` and `*snssz` are set unless the request failed.
    hxa_status_t hxal_scsi_cmnd(const hxal_t* ioc, uint16_t vf_id, wwn_t lpwwn, wwn_t rpwwn, lun_t lun, const scsi_cdb_t* cdb,
                                int write, void* iobuf, uint32_t iosz, uint8_t* scsi_status, void* snsbuf, uint32_t* snssz);

    // The commands that find and identify units. Each writes its own bytes into the caller's `cdb` and leaves the others, which
    // the caller has zeroed or set (the page of an INQUIRY), and sends it. They read, whatever `write` says.
    //     inquiry          INQUIRY (SPC-3): byte 0, and the low 8 bits of `iosz` as allocation length in byte 4
    //     readcapacity     READ CAPACITY (10) (SBC-2): byte 0
    //     readcapacity16   READ CAPACITY (16) (SBC-2): bytes 0 and 1, `iosz` as allocation length in 10 to 13
    //     reportluns       REPORT LUNS (SPC-3): byte 0, `iosz` as allocation length in 6 to 9
    //     testunitready    TEST UNIT READY (SPC-3): byte 0
    hxa_status_t hxal_scsi_inquiry(const hxal_t* ioc, uint16_t vf_id, wwn_t lpwwn, wwn_t rpwwn, lun_t lun, scsi_cdb_t* cdb,
                                   int write, void* iobuf, uint32_t iosz, uint8_t* scsi_status, void* snsbuf, uint32_t* snssz);
    hxa_status_t hxal_scsi_readcapacity(const hxal_t* ioc, uint16_t vf_id, wwn_t lpwwn, wwn_t rpwwn, lun_t lun, scsi_cdb_t* cdb,
                                        int write, void* iobuf, uint32_t iosz, uint8_t* scsi_status, void* snsbuf,
                                        uint32_t* snssz);
    hxa_status_t hxal_scsi_readcapacity16(const hxal_t* ioc, uint16_t vf_id, wwn_t lpwwn, wwn_t rpwwn, lun_t lun, scsi_cdb_t* cdb,
                                          int write, void* iobuf, uint32_t iosz, uint8_t* scsi_status, void* snsbuf,
                                          uint32_t* snssz);
    hxa_status_t hxal_scsi_reportluns(const hxal_t* ioc, uint16_t vf_id, wwn_t lpwwn, wwn_t rpwwn, lun_t lun, scsi_cdb_t* cdb,
                                      int write, void* iobuf, uint32_t iosz, uint8_t* scsi_status, void* snsbuf, uint32_t* snssz);
    hxa_status_t hxal_scsi_testunitready(const hxal_t* ioc, uint16_t vf_id, wwn_t lpwwn, wwn_t rpwwn, lun_t lun, scsi_cdb_t* cdb,
                                         int write, void* iobuf, uint32_t iosz, uint8_t* scsi_status, void* snsbuf,
                                         uint32_t* snssz);

#ifdef __cplusplus
}
#endif
