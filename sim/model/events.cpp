#include "sim/model/events.h"

#include "sim/model/record_fields.h"

namespace hxasim
{

namespace
{

// Addresses lie unaligned in events, out of reach of put_address().
wwn_t as_number(const Wwn& wwn)
{
    wwn_t number = 0;
    put_address(number, wwn);
    return number;
}

void put_adapter(hxa_adapter_aen_data_t& data, const Adapter& adapter)
{
    put_text(data.serial_num, adapter.serial);
    data.nports = static_cast<std::uint32_t>(adapter.ports.size());
    if (!adapter.ports.empty())
        data.pwwn = as_number(adapter.ports.front().pwwn);
}

void put_port(hxa_port_aen_data_t& data, const Ioc& ioc, std::int16_t level)
{
    if (is_fibre_channel(ioc))
    {
        data.pwwn = as_number(ioc.port->pwwn);
        data.fwwn = as_number(ioc.port->fabric_name);
    }
    data.phy_port_num = ioc.port_number;
    data.ioc_type = static_cast<std::int16_t>(ioc.type);
    data.level = level;
    put_address(data.mac, mac_of(ioc));
}

void put_logical_port(hxa_lport_aen_data_t& data, const Ioc& ioc, const Logical_Port& logical)
{
    data.vf_id = logical.virtual_fabric;
    data.roles = static_cast<std::int16_t>(logical.roles);
    data.ppwwn = as_number(ioc.port->pwwn);
    data.lpwwn = as_number(logical.pwwn);
}

void put_remote_port(hxa_rport_aen_data_t& data, const Ioc& ioc, const Logical_Port& logical, const Remote_Port* remote)
{
    data.vf_id = logical.virtual_fabric;
    data.ppwwn = as_number(ioc.port->pwwn);
    data.lpwwn = as_number(logical.pwwn);
    if (!remote)
        return;
    data.rpwwn = as_number(remote->pwwn);
    data.priv = {.qos_priority = remote->qos_priority, .qos_flow_id = remote->qos_flow_id};
}

void put_nexus(hxa_itnim_aen_data_t& data, const Ioc& ioc, const Logical_Port& logical, const Remote_Port* remote)
{
    data.vf_id = logical.virtual_fabric;
    data.ppwwn = as_number(ioc.port->pwwn);
    data.lpwwn = as_number(logical.pwwn);
    if (remote)
        data.rpwwn = as_number(remote->pwwn);
}

void put_ioc(hxa_ioc_aen_data_t& data, const Ioc& ioc)
{
    if (is_fibre_channel(ioc))
        data.pwwn = as_number(ioc.port->pwwn);
    data.ioc_type = static_cast<std::int16_t>(ioc.type);
    put_address(data.mac, mac_of(ioc));
}

void put_ethernet_port(hxa_ethport_aen_data_t& data, const Ioc& ioc)
{
    data.mac = {};
    put_address(data.mac, ioc.port->mac);
    data.cee_state = port_state(ioc) == HXA_PPORT_ST_LINKUP ? HXA_ETHPORT_CEE_LINKUP : HXA_ETHPORT_CEE_LINKDOWN;
}

void put_data(hxa_aen_entry_t& event, const Ioc& ioc, const Event_Subject& subject)
{
    auto& data = event.aen_data;
    const auto& logical = subject.logical ? *subject.logical : ioc.port->base_port;
    const auto* remote = subject.remote;
    if (!remote && !logical.remote_ports.empty())
        remote = &logical.remote_ports.front();
    switch (event.aen_category)
    {
    case HXA_AEN_CAT_ADAPTER:
        return put_adapter(data.adapter, *ioc.adapter);
    case HXA_AEN_CAT_PORT:
        return put_port(data.port, ioc, subject.level);
    case HXA_AEN_CAT_LPORT:
        return put_logical_port(data.lport, ioc, logical);
    case HXA_AEN_CAT_RPORT:
        return put_remote_port(data.rport, ioc, logical, remote);
    case HXA_AEN_CAT_ITNIM:
        return put_nexus(data.itnim, ioc, logical, remote);
    case HXA_AEN_CAT_AUDIT:
        data.audit.pwwn = as_number(ioc.port->pwwn);
        return;
    case HXA_AEN_CAT_IOC:
        return put_ioc(data.ioc, ioc);
    case HXA_AEN_CAT_ETHPORT:
        return put_ethernet_port(data.ethport, ioc);
    default:
        return;
    }
}

} // namespace

hxa_aen_entry_t make_event(const Ioc& ioc, std::uint32_t category, std::uint32_t type, const Event_Subject& subject)
{
    hxa_aen_entry_t event{};
    event.aen_category = category;
    event.aen_type = type;
    put_data(event, ioc, subject);
    return event;
}

} // namespace hxasim
