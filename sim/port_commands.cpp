// Requests to the physical port behind an I/O controller.
#include "sim/command_table.h"
#include "sim/record_fields.h"

namespace hxasim
{

namespace
{

void put_configuration(hxa_pport_cfg_t& field, const Port& port)
{
    field.topology = HXA_PPORT_TOPOLOGY_P2P;
    field.speed = HXA_PPORT_SPEED_AUTO;
    field.maxfrsize = port.max_frame_size;
    field.rx_bbcredit = 8;
    field.tx_bbcredit = 8;
    field.trl_def_speed = HXA_PPORT_SPEED_1GBPS;
    field.path_tov = 30;
    field.q_depth = 32;
}

void put_fibre_channel(hxa_pport_attr_t& field, const Port& port, bool link_up)
{
    put_address(field.nwwn, port.nwwn);
    put_address(field.pwwn, port.pwwn);
    put_address(field.factorynwwn, port.factory_nwwn);
    put_address(field.factorypwwn, port.factory_pwwn);
    put_text(field.port_symname, port.symbolic_name);
    field.cos_supported = FC_CLASS_3;
    field.pbind_enabled = HXA_TRUE;
    field.port_type = port.type;
    if (!link_up)
        return;
    field.topology = port.topology;
    field.pid = port.address;
}

} // namespace

void answer_port_attributes(Call& call, hxa_ioctl_port_attr_t& record)
{
    const auto& ioc = *call.ioc;
    const auto& port = *ioc.port;
    auto& field = record.attr;
    field.port_state = port_state(ioc);
    bool link_up = field.port_state == HXA_PPORT_ST_LINKUP;
    field.speed_supported = port.speed_supported;
    field.speed = link_up ? port.speed : std::uint32_t{HXA_PPORT_SPEED_UNKNOWN};
    field.beacon = port.beacon;
    put_configuration(field.pport_cfg, port);
    if (ioc.type == HXA_IOC_TYPE_LL)
        field.port_type = HXA_PPORT_TYPE_UNKNOWN;
    else
        put_fibre_channel(field, port, link_up);
}

} // namespace hxasim
