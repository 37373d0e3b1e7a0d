// Requests to the physical port behind an I/O controller: attributes, and taking it out of service and back.
#include "sim/commands/row.h"
#include "sim/model/record_fields.h"

namespace hxasim
{

namespace
{

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
    field.pid = address_field(port.base_port.address);
}

void answer_port_attributes(Call& call, hxa_ioctl_port_attr_t& record)
{
    const auto& ioc = *call.ioc;
    const auto& port = *ioc.port;
    auto& field = record.attr;
    field.port_state = port_state(ioc);
    bool link_up = field.port_state == HXA_PPORT_ST_LINKUP;
    field.speed_supported = port.speed_supported;
    field.speed = link_up ? port.speed : std::uint32_t{HXA_PPORT_SPEED_UNKNOWN};
    field.beacon = port.beacon.port_is_on();
    field.link_e2e_beacon = port.beacon.link_is_on();
    field.pport_cfg = port.configuration;
    if (ioc.type == HXA_IOC_TYPE_LL)
        field.port_type = HXA_PPORT_TYPE_UNKNOWN;
    else
        put_fibre_channel(field, port, link_up);
}

void answer_port_enable(Call& call, hxa_ioctl_gen_t& record)
{
    const auto& port = *call.ioc->port;
    auto& state = own_state(*call.ioc);
    if (*call.ioc->state != HXA_IOC_OPERATIONAL)
        record.status = HXA_STATUS_IOC_NON_OP;
    else if (state == HXA_PPORT_ST_PREBOOT_DISABLED)
        record.status = HXA_STATUS_PBC;
    else if (port.loopback_test)
        record.status = HXA_STATUS_DIAG_BUSY;
    else if (is_out_of_service(state))
        state = port.link_state;
}

void answer_port_disable(Call& call, hxa_ioctl_gen_t& record)
{
    auto& state = own_state(*call.ioc);
    if (*call.ioc->state != HXA_IOC_OPERATIONAL)
        record.status = HXA_STATUS_IOC_NON_OP;
    else if (state == HXA_PPORT_ST_PREBOOT_DISABLED)
        record.status = HXA_STATUS_PBC;
    else
        state = HXA_PPORT_ST_DISABLED;
}

// clang-format off
constexpr Row port_table[] = {
    ioc_row<answer_port_enable>(    "IOCMD_PORT_ENABLE"),
    ioc_row<answer_port_disable>(   "IOCMD_PORT_DISABLE"),
    ioc_row<answer_port_attributes>("IOCMD_PORT_GET_ATTR"),
};
// clang-format on

} // namespace

std::span<const Row> port_rows() { return port_table; }

} // namespace hxasim
