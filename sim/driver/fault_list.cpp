#include "sim/driver/fault_list.h"

#include <algorithm>
#include <stdexcept>

namespace hxasim
{

namespace
{

[[noreturn]] void refuse(const std::string& place, const std::string& what) { throw std::runtime_error(place + ": " + what); }

bool fits(const Patch& patch, const Row& row)
{
    return patch.offset <= row.record_size && patch.bytes.size() <= row.record_size - patch.offset;
}

bool can_strike(const Fault& fault, const Row& row)
{
    return (fault.status == 0 || row.status) &&
           std::all_of(fault.answer.begin(), fault.answer.end(), [&](const Patch& patch) { return fits(patch, row); });
}

bool matches(const Fault& fault, const Row& row, Node node, int instance)
{
    return (fault.command.empty() || fault.command == row.command->name) && (fault.node.empty() || fault.node == path_of(node)) &&
           (!fault.instance || *fault.instance == instance) && can_strike(fault, row);
}

void check_against(const Row& row, const Fault& fault, const std::string& place)
{
    if (fault.status != 0 && !row.status)
        refuse(place + ".status", fault.command + " carries no status");
    for (const auto& patch : fault.answer)
        if (!fits(patch, row))
            refuse(place + ".answer", "beyond the " + std::to_string(row.record_size) + " bytes of " + fault.command);
}

} // namespace

void check_fault(const Fault& fault, const std::string& place)
{
    const Row* row = row_named(fault.command);
    if (!fault.command.empty() && !row)
        refuse(place + ".command", "no such command: " + fault.command);
    if (!fault.node.empty() && !node_at(fault.node))
        refuse(place + ".node", "no such node: " + fault.node);
    if (fault.error == 0 && fault.status == 0 && fault.answer.empty() && fault.delay == 0)
        refuse(place, "needs an error, a status, an answer or a delay");
    if (row)
        check_against(*row, fault, place);
}

std::optional<Fault> Fault_List::strike(const Row& row, Node node, int instance)
{
    for (auto& fault : _faults)
    {
        if (!matches(fault, row, node, instance))
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

void overwrite(const std::vector<Patch>& patches, std::span<std::uint8_t> record)
{
    for (const auto& patch : patches)
    {
        auto place = record.subspan(std::min(patch.offset, record.size()));
        std::copy_n(patch.bytes.begin(), std::min(patch.bytes.size(), place.size()), place.begin());
    }
}

} // namespace hxasim
