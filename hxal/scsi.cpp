#include "hxal/scsi.h"

#include "hxal/internal/request.h"

namespace
{

// Operation codes: SPC-3, SBC-2.
constexpr uint8_t test_unit_ready = 0x00;
constexpr uint8_t inquiry = 0x12;
constexpr uint8_t read_capacity_10 = 0x25;
constexpr uint8_t service_action_in_16 = 0x9E;
constexpr uint8_t read_capacity_16 = 0x10; // the service action
constexpr uint8_t report_luns = 0xA0;

void put_length(uint8_t* field, uint32_t length)
{
    field[0] = static_cast<uint8_t>(length >> 24);
    field[1] = static_cast<uint8_t>(length >> 16);
    field[2] = static_cast<uint8_t>(length >> 8);
    field[3] = static_cast<uint8_t>(length);
}

} // namespace

hxa_status_t hxal_scsi_cmnd(const hxal_t* ioc, uint16_t vf_id, wwn_t lpwwn, wwn_t rpwwn, lun_t lun, const scsi_cdb_t* cdb,
                            int write, void* iobuf, uint32_t iosz, uint8_t* scsi_status, void* snsbuf, uint32_t* snssz)
{
    const uint32_t sense_room = snssz ? *snssz : 0;
    if (!ioc || !cdb || (!iobuf && iosz != 0) || (!snsbuf && sense_room != 0))
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_scsi_t>(*ioc);
    record.vf_id = vf_id;
    record.lpwwn = lpwwn;
    record.rpwwn = rpwwn;
    record.lun = lun;
    record.cdb = *cdb;
    record.write = write;
    record.iosz = iosz;
    record.iobuf_ptr = hxal::sender_address(iobuf);
    record.snssz = sense_room;
    record.snsbuf_pt = hxal::sender_address(snsbuf);
    if (const hxa_status_t sent = hxal::send(*ioc, "IOCMD_SCSI_CMND", record); sent != HXA_STATUS_OK)
        return sent;
    if (scsi_status)
        *scsi_status = record.scsi_status;
    if (snssz)
        *snssz = record.snssz;
    return record.status;
}

hxa_status_t hxal_scsi_inquiry(const hxal_t* ioc, uint16_t vf_id, wwn_t lpwwn, wwn_t rpwwn, lun_t lun, scsi_cdb_t* cdb,
                               int /*write*/, void* iobuf, uint32_t iosz, uint8_t* scsi_status, void* snsbuf, uint32_t* snssz)
{
    if (!cdb)
        return HXA_STATUS_EINVAL;
    cdb->scsi_cdb[0] = inquiry;
    cdb->scsi_cdb[4] = static_cast<uint8_t>(iosz);
    return hxal_scsi_cmnd(ioc, vf_id, lpwwn, rpwwn, lun, cdb, 0, iobuf, iosz, scsi_status, snsbuf, snssz);
}

hxa_status_t hxal_scsi_readcapacity(const hxal_t* ioc, uint16_t vf_id, wwn_t lpwwn, wwn_t rpwwn, lun_t lun, scsi_cdb_t* cdb,
                                    int /*write*/, void* iobuf, uint32_t iosz, uint8_t* scsi_status, void* snsbuf,
                                    uint32_t* snssz)
{
    if (!cdb)
        return HXA_STATUS_EINVAL;
    cdb->scsi_cdb[0] = read_capacity_10;
    return hxal_scsi_cmnd(ioc, vf_id, lpwwn, rpwwn, lun, cdb, 0, iobuf, iosz, scsi_status, snsbuf, snssz);
}

hxa_status_t hxal_scsi_readcapacity16(const hxal_t* ioc, uint16_t vf_id, wwn_t lpwwn, wwn_t rpwwn, lun_t lun, scsi_cdb_t* cdb,
                                      int /*write*/, void* iobuf, uint32_t iosz, uint8_t* scsi_status, void* snsbuf,
                                      uint32_t* snssz)
{
    if (!cdb)
        return HXA_STATUS_EINVAL;
    cdb->scsi_cdb[0] = service_action_in_16;
    cdb->scsi_cdb[1] = read_capacity_16;
    put_length(cdb->scsi_cdb + 10, iosz);
    return hxal_scsi_cmnd(ioc, vf_id, lpwwn, rpwwn, lun, cdb, 0, iobuf, iosz, scsi_status, snsbuf, snssz);
}

hxa_status_t hxal_scsi_reportluns(const hxal_t* ioc, uint16_t vf_id, wwn_t lpwwn, wwn_t rpwwn, lun_t lun, scsi_cdb_t* cdb,
                                  int /*write*/, void* iobuf, uint32_t iosz, uint8_t* scsi_status, void* snsbuf, uint32_t* snssz)
{
    if (!cdb)
        return HXA_STATUS_EINVAL;
    cdb->scsi_cdb[0] = report_luns;
    put_length(cdb->scsi_cdb + 6, iosz);
    return hxal_scsi_cmnd(ioc, vf_id, lpwwn, rpwwn, lun, cdb, 0, iobuf, iosz, scsi_status, snsbuf, snssz);
}

hxa_status_t hxal_scsi_testunitready(const hxal_t* ioc, uint16_t vf_id, wwn_t lpwwn, wwn_t rpwwn, lun_t lun, scsi_cdb_t* cdb,
                                     int /*write*/, void* iobuf, uint32_t iosz, uint8_t* scsi_status, void* snsbuf,
                                     uint32_t* snssz)
{
    if (!cdb)
        return HXA_STATUS_EINVAL;
    cdb->scsi_cdb[0] = test_unit_ready;
    return hxal_scsi_cmnd(ioc, vf_id, lpwwn, rpwwn, lun, cdb, 0, iobuf, iosz, scsi_status, snsbuf, snssz);
}
