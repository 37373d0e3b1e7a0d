#include "inventory/hba_port_info.h"

#include "inventory/address_text.h"
#include "inventory/port_states.h"
#include "inventory/property_text.h"

namespace zmlr
{

namespace
{

constexpr uint64 gigabit = 1'000'000'000;

} // namespace

void fill_port(_hbaPortInfo& info, const hxa_pport_attr_t& attributes, int port_index)
{
    ProviderUtil::WWN2str(info.port_wwn, &attributes.pwwn);
    ProviderUtil::WWN2str(info.node_wwn, &attributes.nwwn);
    copy_text(info.address, info.port_wwn);
    copy_text(info.symbolic_name, attributes.port_symname);
    info.operational_status = getPortState(attributes.port_state);
    info.port_type = getPortType(attributes.port_type);
    info.max_frame_size = attributes.pport_cfg.maxfrsize;
    info.speed = uint64{attributes.speed} * gigabit;
    info.max_speed = uint64{attributes.speed_supported} * gigabit;
    info.port_index = static_cast<uint16>(port_index);
}

} // namespace zmlr
