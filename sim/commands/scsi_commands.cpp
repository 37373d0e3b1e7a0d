// SCSI pass-through: a command to a logical unit behind a remote port.
#include "sim/commands/caller_memory.h"
#include "sim/commands/lport_requests.h"
#include "sim/commands/row.h"
#include "sim/commands/scsi_execution.h"

#include <algorithm>
#include <cerrno>

namespace hxasim
{

namespace
{

// Why no command reaches the target; HXA_STATUS_OK when it does.
hxa_status_t refusal(const Ioc& ioc, const Remote_Port& remote)
{
    if (!is_on_line(ioc))
        return HXA_STATUS_PORT_OFFLINE;
    if (remote.state != HXA_RPORT_ONLINE)
        return HXA_STATUS_RPORT_OFFLINE;
    return remote.nexus.state == HXA_ITNIM_ONLINE ? HXA_STATUS_OK : HXA_STATUS_NO_FCPIM_NEXUS;
}

// Copies out what fits into the caller's buffer; how much that was. None: the address is bad.
std::optional<std::uint32_t> hand_over(const std::vector<std::uint8_t>& bytes, std::uint64_t pointer, std::uint32_t room)
{
    const auto size = std::min<std::size_t>(bytes.size(), room);
    if (!copy_to_caller(address_of(pointer), std::span(bytes).first(size)))
        return std::nullopt;
    return static_cast<std::uint32_t>(size);
}

void answer_command(Call& call, hxa_ioctl_scsi_t& record)
{
    const auto* remote = target_of(call, record, record.lpwwn, record.rpwwn);
    if (!remote)
        return;
    record.status = refusal(*call.ioc, *remote);
    if (record.status != HXA_STATUS_OK)
        return;
    const auto answer = execute(remote->scsi, record.lun, record.cdb);
    if (record.write != 0 && !answer.data.empty())
    {
        record.status = HXA_STATUS_EINVAL; // the data go the other way
        return;
    }
    if (!hand_over(answer.data, record.iobuf_ptr, record.iosz))
        return call.refuse(EFAULT, "bad data address");
    const auto sense = hand_over(answer.sense, record.snsbuf_pt, record.snssz);
    if (!sense)
        return call.refuse(EFAULT, "bad sense address");
    record.scsi_status = answer.status;
    record.snssz = *sense;
}

constexpr auto command = [](auto& record)
{
    return std::tie(record.vf_id, record.lpwwn, record.rpwwn, record.lun, record.cdb, record.write, record.iosz, record.snssz,
                    record.iobuf_ptr, record.snsbuf_pt);
};
constexpr auto scsi_buffers = [](const auto& record) {
    return std::vector{Buffer{record.iobuf_ptr, record.iosz}, Buffer{record.snsbuf_pt, record.snssz}};
};

// clang-format off
constexpr Row scsi_table[] = {
    ioc_row<answer_command>("IOCMD_SCSI_CMND", command, scsi_buffers),
};
// clang-format on

} // namespace

std::span<const Row> scsi_rows() { return scsi_table; }

} // namespace hxasim
