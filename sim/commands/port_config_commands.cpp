// Requests that configure the physical port. They are for its FC function; the Ethernet driver supports none of them.
#include "sim/commands/row.h"

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

void answer_topology(Call& call, hxa_ioctl_port_cfg_topo_t& record)
{
    auto* configuration = configuration_of(call, record);
    if (!configuration)
        return;
    if (record.topo == HXA_PPORT_TOPOLOGY_NONE || record.topo > HXA_PPORT_TOPOLOGY_AUTO)
        record.status = HXA_STATUS_EINVAL;
    else
        configuration->topology = static_cast<std::uint8_t>(record.topo);
}

void answer_port_config_speed(Call& call, hxa_ioctl_port_cfg_speed_t& record)
{
    auto* configuration = configuration_of(call, record);
    if (!configuration)
        return;
    if (!can_run_at(*call.ioc->port, record.speed))
        record.status = HXA_STATUS_UNSUPP_SPEED;
    else
        configuration->speed = static_cast<std::uint8_t>(record.speed);
}

void answer_hard_address(Call& call, hxa_ioctl_port_alpa_t& record)
{
    if (auto* configuration = configuration_of(call, record))
    {
        configuration->cfg_hardalpa = HXA_TRUE;
        configuration->hardalpa = record.alpa;
    }
}

void answer_any_address(Call& call, hxa_ioctl_port_alpa_t& record)
{
    if (auto* configuration = configuration_of(call, record))
    {
        configuration->cfg_hardalpa = HXA_FALSE;
        configuration->hardalpa = 0;
    }
}

void answer_frame_size(Call& call, hxa_ioctl_port_cfg_maxfrsize_t& record)
{
    auto* configuration = configuration_of(call, record);
    if (!configuration)
        return;
    if (!is_frame_size(record.maxfrsize))
        record.status = HXA_STATUS_INVLD_DFSZ;
    else
        configuration->maxfrsize = record.maxfrsize;
}

void answer_trunk(Call& call, hxa_ioctl_port_trunk_t& record)
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

void answer_untrunk(Call& call, hxa_ioctl_port_trunk_t& record)
{
    if (auto* configuration = configuration_of(call, record))
    {
        configuration->trunked = HXA_FALSE;
        configuration->trunk_ports = 0;
    }
}

void answer_identify(Call& call, hxa_ioctl_port_rnid_t& record)
{
    if (configuration_of(call, record))
        call.ioc->port->identification = record.info;
}

void answer_identification(Call& call, hxa_ioctl_port_rnid_t& record)
{
    if (configuration_of(call, record))
        record.info = call.ioc->port->identification;
}

constexpr auto topology = [](auto& record) { return std::tie(record.topo); };
constexpr auto speed = [](auto& record) { return std::tie(record.speed); };
constexpr auto address = [](auto& record) { return std::tie(record.alpa); };
constexpr auto frame_size = [](auto& record) { return std::tie(record.maxfrsize); };
constexpr auto trunk = [](auto& record) { return std::tie(record.pp_bmap); };
constexpr auto identity = [](auto& record) { return std::tie(record.info); };

// clang-format off
constexpr Row port_config_table[] = {
    ioc_row<answer_topology>(         "IOCMD_PORT_CFG_TOPO",      topology),
    ioc_row<answer_port_config_speed>("IOCMD_PORT_CFG_SPEED",     speed),
    ioc_row<answer_hard_address>(     "IOCMD_PORT_CFG_ALPA",      address),
    ioc_row<answer_any_address>(      "IOCMD_PORT_CLR_ALPA"),
    ioc_row<answer_frame_size>(       "IOCMD_PORT_CFG_MAXFRSZ",   frame_size),
    ioc_row<answer_trunk>(            "IOCMD_PORT_TRUNK_ENABLE",  trunk),
    ioc_row<answer_untrunk>(          "IOCMD_PORT_TRUNK_DISABLE"),
    ioc_row<answer_identify>(         "IOCMD_PORT_CFG_RNID",      identity),
    ioc_row<answer_identification>(   "IOCMD_PORT_GET_RNID"),
};
// clang-format on

} // namespace

std::span<const Row> port_config_rows() { return port_config_table; }

} // namespace hxasim
