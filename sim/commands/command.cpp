#include "sim/commands/command.h"

#include <algorithm>
#include <array>

namespace hxasim
{

namespace
{

using Table = std::array<const Row*, hxal::catalogue.size()>;

// The rows in the order of the catalogue.
const Table& table()
{
    static const Table sorted = []
    {
        Table by_command{};
        for (auto* group :
             {driver_rows, ioc_rows, iocfc_rows, event_rows, diag_rows, port_rows, port_config_rows, statistics_rows,
              ethport_rows, sfp_rows, flash_rows, lport_rows, rport_rows, itnim_rows, scsi_rows, fcpt_rows})
            for (const auto& row : group())
                by_command[static_cast<std::size_t>(row.command - hxal::catalogue.data())] = &row;
        return by_command;
    }();
    return sorted;
}

} // namespace

const Row* row_of(const hxal::Command& command) { return table()[static_cast<std::size_t>(&command - hxal::catalogue.data())]; }

const Row* row_named(std::string_view wanted)
{
    auto found =
        std::find_if(table().begin(), table().end(), [&](const Row* row) { return row && row->command->name == wanted; });
    return found == table().end() ? nullptr : *found;
}

} // namespace hxasim
