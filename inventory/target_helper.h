// TargetHelper: the logical units behind the remote ports of one FC port, found by asking them (SPC-3). Nothing is remembered:
// every call asks again.
#pragma once

#include "hxal/hxal.h"
#include "inventory/class_id.h"
#include "inventory/hba_port_info.h"
#include "inventory/inventory_request.h"
#include "runtime/instance.h"

namespace zmlr
{

class TargetHelper
{
public:
    static const TargetHelper& getTargetHelperObject();

    // The ZEMLAR_StorageExtent or ZEMLAR_TapeDrive instances of the units behind the port, in the order of its remote ports and
    // of their REPORT LUNS; LUN 0 tells for all units of a remote port whether they are tape devices. Requests: one for the
    // remote ports, then for each one its attributes, an INQUIRY to LUN 0, one REPORT LUNS or two, and up to three INQUIRY a
    // unit. A remote port or unit that does not answer, or not with SCSI status GOOD, is skipped with a log line.
    // `ioc` is the port's FC IOC, `port` its record.
    Instance_Array getTargetInstances(const hxal_t* ioc, const _hbaPortInfo& port, classId_t id,
                                      const Inventory_Request& request) const;

    // Sends an INQUIRY, for a vital product data page when `evpd` is set. `*size` and `*sense_size` are the rooms in the buffers;
    // the latter comes back as the driver gives it.
    hxa_status_t sendSCSIInquiry(const hxal_t* ioc, wwn_t lpwwn, wwn_t rpwwn, uint16_t vf_id, lun_t lun, bool evpd,
                                 std::uint8_t page, void* data, std::uint32_t* size, std::uint8_t* scsi_status, void* sense,
                                 std::uint32_t* sense_size) const;

private:
    TargetHelper() = default;
};

} // namespace zmlr
