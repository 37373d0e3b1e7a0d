// Requests that configure the physical port. They are for its FC function; the Ethernet driver supports none of them.
#include "sim/command_table.h"

namespace hxasim
{

namespace
{

// The port's FC configuration; null, with the record's status set, on the Ethernet side.
template <typename Record> hxa_pport_cfg_t* configuration_of(Call& call, Record& record)
{
    if (call.ioc->type != HXA_IOC_TYPE_LL)
        return &call.ioc->port->configuration;
    record.status = HXA_STATUS_CMD_NOTSUPP;
    return nullptr;
}

// FC-FS-2: the receive data field size of a port.
bool is_frame_size(std::uint16_t size) { return size >= 256 && size <= 2112 && size % 4 == 0; }

} // namespace

void answer_port_topology(Call& call, hxa_ioctl_port_cfg_topo_t& record)
{
    auto* configuration = configuration_of(call, record);
    if (!configuration)
        return;
    if (record.topo == HXA_PPORT_TOPOLOGY_NONE || record.topo > HXA_PPORT_TOPOLOGY_AUTO)
        record.status = HXA_STATUS_EINVAL;
    else
        configuration->topology = static_cast<std::uint8_t>(record.topo);
}

void answer_port_speed(Call& call, hxa_ioctl_port_cfg_speed_t& record)
{
    auto* configuration = configuration_of(call, record);
    if (!configuration)
        return;
    if (!can_run_at(*call.ioc->port, record.speed))
        record.status = HXA_STATUS_UNSUPP_SPEED;
    else
        configuration->speed = static_cast<std::uint8_t>(record.speed);
}

void answer_port_hard_address(Call& call, hxa_ioctl_port_alpa_t& record)
{
    if (auto* configuration = configuration_of(call, record))
    {
        configuration->cfg_hardalpa = HXA_TRUE;
        configuration->hardalpa = record.alpa;
    }
}

void answer_port_any_address(Call& call, hxa_ioctl_port_alpa_t& record)
{
    if (auto* configuration = configuration_of(call, record))
    {
        configuration->cfg_hardalpa = HXA_FALSE;
        configuration->hardalpa = 0;
    }
}

void answer_port_frame_size(Call& call, hxa_ioctl_port_cfg_maxfrsize_t& record)
{
    auto* configuration = configuration_of(call, record);
    if (!configuration)
        return;
    if (!is_frame_size(record.maxfrsize))
        record.status = HXA_STATUS_INVLD_DFSZ;
    else
        configuration->maxfrsize = record.maxfrsize;
}

void answer_port_trunk(Call& call, hxa_ioctl_port_trunk_t& record)
{
    auto* configuration = configuration_of(call, record);
    if (!configuration)
        return;
    if (record.pp_bmap == 0 || record.pp_bmap >> call.ioc->adapter->ports.size() != 0)
        record.status = HXA_STATUS_EINVAL;
    else
    {
        configuration->trunked = HXA_TRUE;
        configuration->trunk_ports = record.pp_bmap;
    }
}

void answer_port_untrunk(Call& call, hxa_ioctl_port_trunk_t& record)
{
    if (auto* configuration = configuration_of(call, record))
    {
        configuration->trunked = HXA_FALSE;
        configuration->trunk_ports = 0;
    }
}

void answer_port_identify(Call& call, hxa_ioctl_port_rnid_t& record)
{
    if (configuration_of(call, record))
        call.ioc->port->identification = record.info;
}

void answer_port_identification(Call& call, hxa_ioctl_port_rnid_t& record)
{
    if (configuration_of(call, record))
        record.info = call.ioc->port->identification;
}

} // namespace hxasim
