#include "cli/virtual_ports.h"

#include "cli/field_text.h"
#include "cli/report.h"
#include "hxal/config/parser.h"
#include "hxal/lport.h"

#include <iterator>

namespace hxa
{

namespace
{

// clang-format off
constexpr Column columns[] = {
    {"Port",         "port"},
    {"Virtual port", "wwn"},
    {"Virtual node", "node_wwn"},
    {"Fabric",       "virtual_fabric"},
    {"State",        "state"},
    {"Address",      "address"},
    {"Roles",        "roles"},
    {"Name",         "symbolic_name"},
};

constexpr const char* states[] = {"uninit", "fdisc", "online", "offline"}; // hxa_port_state_t
// clang-format on

List role_words(std::uint32_t roles)
{
    List words;
    if (roles & HXA_PORT_ROLE_FCP_IM)
        words.push_back("initiator");
    if (roles & HXA_PORT_ROLE_FCP_TM)
        words.push_back("target");
    if (roles & HXA_PORT_ROLE_FCP_IPFC)
        words.push_back("IP");
    return words;
}

Value tree_of(Session& session, const Port& port, const hxal_vf_config_t& configured)
{
    const auto wwn = read_wwn(configured.pwwn);
    const auto name = wwn ? wwn_text(*wwn) : field_text(configured.pwwn);
    Object tree{{"port", port.name()}, {"wwn", name}, {"virtual_fabric", unsigned{configured.vf_id}}};
    hxa_port_attr_t attr{};
    // A text that is no WWN names no port.
    const auto status = wwn ? hxal_lport_get_attr(port.fc, configured.vf_id, *wwn, &attr) : HXA_STATUS_UNKNOWN_LWWN;
    if (status == HXA_STATUS_UNKNOWN_LWWN || status == HXA_STATUS_UNKNOWN_VWWN || status == HXA_STATUS_UNKNOWN_VFID)
        tree.push_back({"state", "missing"});
    else if (session.accept(status, "virtual port " + name))
        for (auto& member : Object{{"node_wwn", wwn_text(attr.port_cfg.nwwn)},
                                   {"state", attr.state < std::size(states) ? Value(states[attr.state]) : Value(attr.state)},
                                   {"address", attr.pid ? Value(address_text(attr.pid)) : Value()},
                                   {"roles", role_words(attr.port_cfg.roles)},
                                   {"symbolic_name", field_text(attr.port_cfg.sym_name)},
                                   {"preboot", attr.port_cfg.preboot_vp != 0}})
            tree.push_back(member);
    return tree;
}

} // namespace

void show_virtual_ports(Session& session, const std::vector<Port>& ports, const std::string& file)
{
    hxal_config_load(file.c_str());
    List trees;
    for (const auto& port : ports)
    {
        const int entry = port.fc ? hxal_config_ioc_lookup(port.fc->pwwn) : -1;
        for (const auto* next = entry < 0 ? nullptr : hxal_config_get()->iocs[entry].vport; next; next = next->next)
            trees.push_back(tree_of(session, port, *next));
    }
    session.answer(Object{{"virtual_ports", trees}}, table(trees, columns));
}

} // namespace hxa
