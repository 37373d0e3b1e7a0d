#include "sim/driver/fault_list.h"

#include "sim/commands/scsi_lun.h"

#include <algorithm>
#include <cstring>
#include <stdexcept>

namespace hxasim
{

namespace
{

[[noreturn]] void refuse_fault(const std::string& place, const std::string& what)
{
    throw std::runtime_error(place + ": " + what);
}

bool fits(const Patch& patch, const Row& row)
{
    return patch.offset <= row.record_size && patch.bytes.size() <= row.record_size - patch.offset;
}

bool is_of_scsi(const Fault& fault) { return fault.lun || !fault.cdb.empty() || fault.scsi_status; }

// Why the fault cannot strike such a request, and the member that says so; none when it can.
struct Obstacle
{
    const char* member;
    std::string why;
};

std::optional<Obstacle> obstacle(const Fault& fault, const Row& row)
{
    const std::string name(row.command->name);
    if (fault.status != 0 && !row.status)
        return Obstacle{".status", name + " carries no status"};
    if (fault.remote_port && !row.remote_port)
        return Obstacle{".remote_port", name + " names no remote port"};
    if (is_of_scsi(fault) && !row.is_scsi)
        return Obstacle{"", name + " is no SCSI command"};
    if (!fault.data.empty() && !row.buffers)
        return Obstacle{".data", name + " fills no buffer"};
    if (!std::all_of(fault.answer.begin(), fault.answer.end(), [&](const Patch& patch) { return fits(patch, row); }))
        return Obstacle{".answer", "beyond the " + std::to_string(row.record_size) + " bytes of " + name};
    return std::nullopt;
}

bool does_nothing(const Fault& fault)
{
    return fault.error == 0 && fault.status == 0 && !fault.scsi_status && !fault.garbage && fault.answer.empty() &&
           fault.data.empty() && fault.delay == 0;
}

bool names_remote_port(const Fault& fault, const Row& row, std::span<const std::uint8_t> sent)
{
    return !fault.remote_port || std::memcmp(&sent[*row.remote_port], fault.remote_port->data(), fault.remote_port->size()) == 0;
}

bool names_command(const Fault& fault, std::span<const std::uint8_t> sent)
{
    hxa_ioctl_scsi_t record;
    std::memcpy(&record, sent.data(), sizeof(record));
    Lun_Bytes lun;
    std::memcpy(lun.data(), &record.lun, sizeof(record.lun));
    const auto first = std::span(record.cdb.scsi_cdb).first(std::min(fault.cdb.size(), sizeof(record.cdb)));
    return (!fault.lun || unit_number(lun) == *fault.lun) && std::equal(first.begin(), first.end(), fault.cdb.begin());
}

bool matches(const Fault& fault, const Row& row, Node node, int instance, std::span<const std::uint8_t> sent)
{
    return (fault.command.empty() || fault.command == row.command->name) && (fault.node.empty() || fault.node == path_of(node)) &&
           (!fault.instance || *fault.instance == instance) && !obstacle(fault, row) && names_remote_port(fault, row, sent) &&
           (!is_of_scsi(fault) || names_command(fault, sent));
}

} // namespace

void check_fault(const Fault& fault, const std::string& place)
{
    const Row* row = row_named(fault.command);
    if (!fault.command.empty() && !row)
        refuse_fault(place + ".command", "no such command: " + fault.command);
    if (!fault.node.empty() && !node_at(fault.node))
        refuse_fault(place + ".node", "no such node: " + fault.node);
    if (does_nothing(fault))
        refuse_fault(place, "needs an error, a status, a SCSI status, an answer, data, garbage or a delay");
    const auto found = row ? obstacle(fault, *row) : std::nullopt;
    if (found)
        refuse_fault(place + found->member, found->why);
}

std::optional<Fault> Fault_List::strike(const Row& row, Node node, int instance, std::span<const std::uint8_t> sent)
{
    for (auto& fault : _faults)
    {
        if (!matches(fault, row, node, instance, sent))
            continue;
        if (fault.skip > 0)
            --fault.skip;
        else if (fault.times < 0)
            return fault;
        else if (fault.times > 0)
        {
            --fault.times;
            return fault;
        }
    }
    return std::nullopt;
}

} // namespace hxasim
