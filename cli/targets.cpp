#include "cli/commands.h"
#include "cli/field_text.h"
#include "cli/luns.h"
#include "cli/report.h"
#include "cli/trees.h"
#include "hxal/itnim.h"
#include "hxal/lport.h"
#include "hxal/rport.h"
#include "hxal/value_names.h"

#include <algorithm>

namespace hxa
{

namespace
{

constexpr std::uint32_t most_remote_ports = 2048;

// clang-format off
constexpr Column remote_columns[] = {
    {"Port",        "port"},
    {"Remote port", "wwn"},
    {"Remote node", "node_wwn"},
    {"Address",     "address"},
    {"Role",        "role"},
    {"State",       "state"},
    {"Nexus",       "nexus.state"},
    {"Speed",       "speed_gbps", " Gbit/s"},
    {"Name",        "symbolic_name"},
};

constexpr Column lun_columns[] = {
    {"Port",        "port"},
    {"Remote port", "wwn"},
    {"LUN",         "unit.lun"},
    {"Type",        "unit.type"},
    {"Vendor",      "unit.vendor"},
    {"Product",     "unit.product"},
    {"Rev",         "unit.revision"},
    {"Serial",      "unit.serial_number"},
    {"Capacity",    "unit.capacity_bytes", " B"},
};
// clang-format on

List roles(std::uint32_t function)
{
    List words;
    if (function & HXA_RPORT_INITIATOR)
        words.push_back("initiator");
    if (function & HXA_RPORT_TARGET)
        words.push_back("target");
    return words;
}

Value scsi_address(const Port& port, wwn_t wwn)
{
    std::uint32_t host = 0, bus = 0, target = 0;
    if (hxal_rport_get_scsi_address(port.fc, 0, port.fc->pwwn, wwn, &host, &bus, &target) != HXA_STATUS_OK)
        return {};
    return Object{{"host", host}, {"bus", bus}, {"target", target}};
}

Value nexus(Session& session, const Port& port, wwn_t wwn)
{
    hxa_itnim_attr_t attr{};
    if (!session.accept(hxal_itnim_get_attr(port.fc, 0, port.fc->pwwn, wwn, &attr), "nexus to remote port " + wwn_text(wwn)))
        return {};
    return Object{{"state", hxal_itnim_state_to_string(attr.state)},
                  {"data_retransmission", attr.retry != 0},
                  {"task_retry_identification", attr.task_retry_id != 0},
                  {"read_exchange_concise", attr.rec_support != 0},
                  {"confirmed_completion", attr.conf_comp != 0}};
}

Value remote_tree(Session& session, const Port& port, wwn_t wwn, bool with_luns)
{
    Object tree{{"port", port.name()}, {"wwn", wwn_text(wwn)}};
    hxa_rport_attr_t attr{};
    if (!session.accept(hxal_rport_get_attr(port.fc, 0, port.fc->pwwn, wwn, &attr), "remote port " + wwn_text(wwn)))
        return tree;
    const bool is_target = attr.scsi_function & HXA_RPORT_TARGET;
    for (auto& member : Object{{"node_wwn", wwn_text(attr.nwwn)},
                               {"address", address_text(attr.pid)},
                               {"role", roles(attr.scsi_function)},
                               {"state", hxal_rport_state_to_string(attr.state)},
                               {"speed_gbps", speed_value(attr.curr_speed)},
                               {"frame_size_bytes", attr.df_sz},
                               {"symbolic_name", field_text(attr.symname)},
                               {"rate_limited", attr.trl_enforced != 0},
                               {"qos_priority", hxal_qos_priority_to_string(attr.qos_attr.qos_priority)}})
        tree.push_back(member);
    if (is_target)
    {
        tree.push_back({"nexus", nexus(session, port, wwn)});
        tree.push_back({"scsi_address", scsi_address(port, wwn)});
    }
    if (is_target && with_luns)
        tree.push_back({"units", luns_of(session, port, wwn)});
    return tree;
}

std::vector<wwn_t> remote_ports(Session& session, const Port& port)
{
    std::vector<wwn_t> wwns(most_remote_ports);
    auto count = most_remote_ports;
    if (!session.accept(hxal_lport_get_rports(port.fc, 0, port.fc->pwwn, wwns.data(), &count),
                        "remote ports of port " + port.name()))
        count = 0;
    wwns.resize(std::min(count, most_remote_ports));
    return wwns;
}

std::string text_of(const List& remotes, bool with_luns)
{
    List rows;
    for (const auto& remote : remotes)
        for (const auto& unit : remote.at("units").list())
            rows.push_back(Object{{"port", remote.at("port")}, {"wwn", remote.at("wwn")}, {"unit", unit}});
    return table(remotes, remote_columns) + (with_luns ? '\n' + table(rows, lun_columns) : std::string());
}

} // namespace

void targets(Session& session, const Targets_Options& options)
{
    const Host host(session);
    List remotes;
    for (const auto& port : host.ports(options.port))
        if (port.fc)
            for (const auto wwn : remote_ports(session, port))
                remotes.push_back(remote_tree(session, port, wwn, !options.no_luns));
    session.answer(Object{{"remote_ports", remotes}}, text_of(remotes, !options.no_luns));
}

} // namespace hxa
