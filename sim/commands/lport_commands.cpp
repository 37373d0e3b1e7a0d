// Requests to a logical port.
#include "sim/commands/lport_requests.h"
#include "sim/commands/row.h"

#include "sim/commands/caller_memory.h"
#include "sim/model/record_fields.h"

#include <algorithm>
#include <cerrno>

namespace hxasim
{

namespace
{

// Fabric-provided MAC address of an FCoE port (FC-BB-5): the usual prefix of the fabric, then the FC address.
Mac fabric_mac(std::uint32_t address)
{
    const auto own = wire_address(address);
    return {0x0E, 0xFC, 0x00, own[0], own[1], own[2]};
}

void put_fabric(hxa_port_attr_t& field, const Ioc& ioc, const Logical_Port& logical)
{
    field.pid = address_field(logical.address);
    if (ioc.port->topology != HXA_PPORT_TOPOLOGY_LOOP)
        put_address(field.fabric_name, ioc.port->fabric_name);
    if (ioc.type == HXA_IOC_TYPE_FCoE)
        put_address(field.fpma_mac, fabric_mac(logical.address));
}

void answer_lport_attributes(Call& call, hxa_ioctl_lport_attr_t& record)
{
    const auto* logical = logical_port_of(call, record, record.pwwn);
    if (!logical)
        return;
    auto& field = record.attr;
    field.state = is_on_line(*call.ioc) ? HXA_PORT_ONLINE : HXA_PORT_OFFLINE;
    put_address(field.port_cfg.pwwn, logical->pwwn);
    put_address(field.port_cfg.nwwn, logical->nwwn);
    put_text(field.port_cfg.sym_name, logical->symbolic_name);
    field.port_cfg.preboot_vp = logical->preboot;
    field.port_cfg.roles = logical->roles;
    field.port_type = logical->type;
    if (is_on_line(*call.ioc))
        put_fabric(field, *call.ioc, *logical);
}

void answer_lport_reset_statistics(Call& call, hxa_ioctl_lport_reset_stats_t& record)
{
    if (auto* logical = logical_port_of(call, record, record.pwwn))
        logical->counters.reset();
}

void answer_remote_ports(Call& call, hxa_ioctl_lport_get_rports_t& record)
{
    const auto* logical = logical_port_of(call, record, record.pwwn);
    if (!logical)
        return;
    std::vector<std::uint8_t> wwns;
    if (is_on_line(*call.ioc))
        for (const auto& remote : logical->remote_ports)
            if (remote.known)
                wwns.insert(wwns.end(), remote.pwwn.begin(), remote.pwwn.end());
    wwns.resize(std::min(wwns.size(), sizeof(wwn_t) * record.nrports));
    if (!wwns.empty() && !copy_to_caller(address_of(record.rbuf_ptr), wwns))
        return call.refuse(EFAULT, "bad address of the list");
    record.nrports = static_cast<std::uint32_t>(wwns.size() / sizeof(wwn_t));
}

constexpr auto lport_key = [](auto& record) { return std::tie(record.vf_id, record.pwwn); };
constexpr auto list = [](auto& record) { return std::tie(record.vf_id, record.pwwn, record.rbuf_ptr, record.nrports); };
constexpr auto lport_buffers = [](const auto& record) {
    return std::vector{Buffer{record.rbuf_ptr, sizeof(wwn_t) * std::uint64_t{record.nrports}}};
};

// clang-format off
constexpr Row lport_table[] = {
    ioc_row<answer_lport_attributes>(      "IOCMD_LPORT_GET_ATTR",    lport_key),
    ioc_row<answer_lport_reset_statistics>("IOCMD_LPORT_RESET_STATS", lport_key),
    ioc_row<answer_remote_ports>(          "IOCMD_LPORT_GET_RPORTS",  list, lport_buffers),
};
// clang-format on

} // namespace

std::span<const Row> lport_rows() { return lport_table; }

} // namespace hxasim
