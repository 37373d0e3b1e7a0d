#include "inventory/target_helper.h"

#include "inventory/address_text.h"
#include "inventory/remote_ports.h"
#include "inventory/scsi_pages.h"
#include "inventory/storage_instances.h"
#include "runtime/log.h"
#include "runtime/trace.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cstring>
#include <memory>
#include <new>
#include <optional>
#include <vector>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "TargetHelper";

constexpr std::size_t first_list_size = 816; // REPORT LUNS: room for 101 units
constexpr std::size_t max_units = 65536;     // more than a target can have
constexpr std::uint32_t max_sense = 18;
constexpr std::uint8_t identification_page = 0x83;
constexpr std::uint8_t serial_page = 0x80;

// The way to one remote port.
struct Nexus
{
    const hxal_t* ioc;
    wwn_t port;
    wwn_t remote_port;
};

// The digits of a WWN as one number.
unsigned long long number_of(wwn_t wwn)
{
    unsigned long long number = 0;
    for (const std::uint8_t byte : std::bit_cast<std::array<std::uint8_t, sizeof wwn>>(wwn))
        number = number << 8 | byte;
    return number;
}

lun_t lun_of(const _hbaLunInfo& info)
{
    lun_t lun;
    std::memcpy(&lun, info.lun.data(), sizeof lun);
    return lun;
}

// One INQUIRY: empty, with a log line made of `failure` and the status, unless the unit answered with GOOD. Without a page it
// asks for the standard data.
template <class Data>
std::optional<Data> inquire(const Nexus& nexus, lun_t lun, std::optional<std::uint8_t> page, const char* failure)
{
    Data data{};
    auto size = static_cast<std::uint32_t>(data.size());
    std::array<std::uint8_t, max_sense> sense{};
    std::uint32_t sense_room = max_sense;
    std::uint8_t scsi_status = 0;
    const hxa_status_t status = TargetHelper::getTargetHelperObject().sendSCSIInquiry(
        nexus.ioc, nexus.port, nexus.remote_port, base_fabric, lun, page.has_value(), page.value_or(0), data.data(), &size,
        &scsi_status, sense.data(), &sense_room);
    if (status == HXA_STATUS_OK && scsi_status == 0)
        return data;
    ZMLR_LOG(LL_ERR, failure, static_cast<int>(status));
    return std::nullopt;
}

// The answer to one REPORT LUNS with room for `size` bytes; null, with log lines, when there is none.
std::unique_ptr<std::uint8_t[]> report_luns(const Nexus& nexus, std::size_t size)
{
    std::unique_ptr<std::uint8_t[]> list(new (std::nothrow) std::uint8_t[size]());
    if (!list)
    {
        ZMLR_LOG(LL_ERR, "Memory allocation failed for %u bytes.", static_cast<unsigned>(size));
        return nullptr;
    }

    scsi_cdb_t cdb{};
    std::array<std::uint8_t, max_sense> sense{};
    std::uint32_t sense_room = max_sense;
    std::uint8_t scsi_status = 0;
    const hxa_status_t status =
        hxal_scsi_reportluns(nexus.ioc, base_fabric, nexus.port, nexus.remote_port, lun_t{0}, &cdb, 0, list.get(),
                             static_cast<std::uint32_t>(size), &scsi_status, sense.data(), &sense_room);
    if (status == HXA_STATUS_OK && scsi_status == 0)
        return list;
    if (status != HXA_STATUS_OK)
        ZMLR_LOG(LL_ERR, "hxal_scsi_reportluns returned error -  %d", static_cast<int>(status));
    else
        ZMLR_LOG(LL_ERR, "scsistatus is %x.", scsi_status);
    return nullptr;
}

using Lun = std::array<std::uint8_t, lun_entry_size>; // as REPORT LUNS gives it

// The wanted ones of an answer's entries, in room of their own: the answer is larger, and they are kept while each is asked.
std::vector<Lun> wanted_units(const std::uint8_t* answer, std::size_t count, const Wanted& wanted)
{
    std::vector<Lun> units;
    if (wanted.is_all())
        units.reserve(count);
    for (std::size_t i = 0; i < count; i++)
    {
        const Lun_Entry entry(answer + lun_list_head + i * lun_entry_size, lun_entry_size);
        if (wanted.may_end_with_number(lun_number(entry)))
            std::ranges::copy(entry, units.emplace_back().begin());
    }
    return units;
}

// The wanted units of a target, none when it does not tell. A target that tells of more than its answer had room for is asked
// once more; what then does not fit is not there.
std::vector<Lun> list_luns(const Nexus& nexus, int index, const Wanted& wanted)
{
    std::size_t size = first_list_size;
    for (bool again = true;; again = false)
    {
        ZMLR_LOG(LL_INFO, "lunInvSize = %u. rPortWwns[%d]=%llx", static_cast<unsigned>(size), index,
                 number_of(nexus.remote_port));
        const auto list = report_luns(nexus, size);
        if (!list)
        {
            ZMLR_LOG(LL_INFO, "Continue with next rport. Reportlun had issue. ");
            return {};
        }
        const std::size_t told = lun_count({list.get(), size});
        if (!again || told <= lun_room(size))
        {
            const std::size_t count = std::min(told, lun_room(size));
            ZMLR_LOG(LL_INFO, "Number of Luns = %d.", static_cast<int>(count));
            return wanted_units(list.get(), count, wanted);
        }
        ZMLR_LOG(LL_INFO, "More luns reported than initially expected. need to reportLun with more space allocated.");
        size = std::min(told, max_units) * lun_entry_size + lun_list_head;
    }
}

void identify_by_serial_number(const Nexus& nexus, _hbaLunInfo& info)
{
    ZMLR_LOG(LL_INFO, "scsiInquiry for Unit serial number.");
    const auto page = inquire<Serial_Page>(nexus, lun_of(info), serial_page,
                                           "sendSCSIInquiry for EVPD(Unit serial number page) returned error -  %d");
    if (page)
        fill_serial_number(info, *page);
    else
        info.identifier_type = IDENTIFIER_UNAVAILABLE;
}

// Asks one unit what it is; false when it does not say.
bool read_unit(const Nexus& nexus, _hbaLunInfo& info)
{
    ZMLR_LOG(LL_INFO, "scsiInquiry for VendorId and Product Id ");
    const auto inquiry = inquire<Inquiry_Data>(nexus, lun_of(info), std::nullopt, "sendSCSIInquiry for lun returned error -  %d");
    if (!inquiry)
    {
        ZMLR_LOG(LL_INFO, "Continue with next lun as inquiry data is necessary. ");
        return false;
    }
    fill_inquiry(info, *inquiry);

    ZMLR_LOG(LL_INFO, "scsiInquiry for Device Identification Page.");
    const auto page = inquire<Identification_Page>(nexus, lun_of(info), identification_page,
                                                   "sendSCSIInquiry for DeviceIdentificationPage DIP. 83 -  %d");
    if (!page || !fill_identifier(info, *page))
        identify_by_serial_number(nexus, info);
    return true;
}

// True when the remote port is a target whose LUN 0 is a device of the wanted kind.
bool is_target_of_kind(const Nexus& nexus, classId_t id)
{
    hxa_rport_attr_t attributes{};
    const hxa_status_t status = hxal_rport_get_attr(nexus.ioc, base_fabric, nexus.port, nexus.remote_port, &attributes);
    if (status != HXA_STATUS_OK)
    {
        ZMLR_LOG(LL_ERR, "hxal_rport_get_attr returned error -  %d", static_cast<int>(status));
        return false;
    }
    if (attributes.scsi_function != HXA_RPORT_TARGET)
    {
        ZMLR_LOG(LL_INFO, "Nothing to do since the its not a Target Rport.");
        return false;
    }

    ZMLR_LOG(LL_INFO, "ScsiInquiry invoked for general details");
    const auto inquiry = inquire<Inquiry_Data>(nexus, lun_t{0}, std::nullopt, "hba_SendSCSIInquiry returned error -  %d");
    if (!inquiry)
        return false;
    ZMLR_LOG(LL_INFO, "Device type  =   %d", (*inquiry)[0] & 0x1F);
    if (is_tape_device(*inquiry) == (id == CLASSID_TapeDrive))
        return true;
    ZMLR_LOG(LL_INFO, "Continue with next rport. Looking for another device type ");
    return false;
}

void append_unit(Instance_Array& instances, const _hbaPortInfo& port, const _hbaLunInfo& lun, classId_t id)
{
    if (id == CLASSID_TapeDrive)
        instances.adopt(getTapeDriveInstance(port, lun));
    else
        instances.adopt(getStorageExtentInstance(port, lun));
}

void append_units(Instance_Array& instances, const Nexus& nexus, int index, const _hbaPortInfo& port, classId_t id,
                  const Wanted& wanted)
{
    for (const Lun& lun : list_luns(nexus, index, wanted))
    {
        _hbaLunInfo info;
        info.lun = lun;
        ProviderUtil::WWN2str(info.target_wwn, &nexus.remote_port);
        if (read_unit(nexus, info))
            append_unit(instances, port, info, id);
    }
}

} // namespace

const TargetHelper& TargetHelper::getTargetHelperObject()
{
    static constinit const TargetHelper helper;
    return helper;
}

Instance_Array TargetHelper::getTargetInstances(const hxal_t* ioc, const _hbaPortInfo& port, classId_t id,
                                                const Inventory_Request& request) const
{
    const Scope_Trace trace(log_source);
    Instance_Array instances;
    Nexus nexus = {.ioc = ioc, .port = 0, .remote_port = 0};
    ProviderUtil::getRawWWNFromStr(port.port_wwn, reinterpret_cast<unsigned char*>(&nexus.port));

    const Remote_Ports remote_ports(ioc, nexus.port, log_source, LL_INFO);
    int index = 0;
    for (const wwn_t remote_port : remote_ports.wwns())
    {
        ZMLR_LOG(LL_INFO, "Loop for the rport index =   %d", index);
        nexus.remote_port = remote_port;
        if (request.wanted.may_hold(remote_port) && is_target_of_kind(nexus, id))
            append_units(instances, nexus, index, port, id, request.wanted);
        index++;
    }
    return instances;
}

hxa_status_t TargetHelper::sendSCSIInquiry(const hxal_t* ioc, wwn_t lpwwn, wwn_t rpwwn, uint16_t vf_id, lun_t lun, bool evpd,
                                           std::uint8_t page, void* data, std::uint32_t* size, std::uint8_t* scsi_status,
                                           void* sense, std::uint32_t* sense_size) const
{
    const Scope_Trace trace(log_source);
    // SPC-3, 6.4: operation code, EVPD, page code, allocation length in two bytes.
    scsi_cdb_t cdb{};
    cdb.scsi_cdb[0] = 0x12;
    cdb.scsi_cdb[1] = evpd ? 1 : 0;
    cdb.scsi_cdb[2] = page;
    cdb.scsi_cdb[3] = static_cast<std::uint8_t>(*size >> 8);
    cdb.scsi_cdb[4] = static_cast<std::uint8_t>(*size);

    ZMLR_LOG(LL_INFO, "Invoking hxal_scsi_cmnd with SCSI_OP_INQUIRY ");
    const hxa_status_t status =
        hxal_scsi_cmnd(ioc, vf_id, lpwwn, rpwwn, lun, &cdb, 0, data, *size, scsi_status, sense, sense_size);
    ZMLR_LOG(LL_INFO, "completed  hxal_scsi_cmnd(SCSI_OP_INQUIRY) status = %d, pScsiStatus = %x", static_cast<int>(status),
             *scsi_status);
    return status;
}

} // namespace zmlr
