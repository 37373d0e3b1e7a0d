#include "inventory/ethernet_port_info.h"

#include "inventory/address_text.h"
#include "inventory/port_states.h"
#include "inventory/property_text.h"
#include "runtime/trace.h"

#include <cstring>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "EthernetPortHelper";

struct Media_Type
{
    const char* media;
    uint16 port_type;
};

constexpr Media_Type media_types[] = {
    {"10G_BASE-SR", 105}, // 10GBase-SR
    {"10G_BASE-LR", 108}, // 10GBase-LR
    {"10G_BASE-LRM", 108},
};

} // namespace

void fill_ethernet_port(_ethPortInfo& info, const hxal_t* ethernet, const hxa_ethport_attr_t& attributes, int port_index)
{
    const mac_t mac = hxal_ioc_get_mac(ethernet);
    ProviderUtil::MAC2str(info.mac, &mac);
    copy_text(info.permanent_mac, info.mac);
    copy_text(info.interface_name, sizeof info.interface_name, hxal_ioc_get_eth_name(ethernet), sizeof ethernet->eth_name);
    info.operational_status = getPortState(attributes.port_state);
    info.port_index = static_cast<uint16>(port_index);
    info.mtu = attributes.mtu;
}

uint16 getEthernetPortType(const char* media)
{
    const Scope_Trace trace(log_source, "getPortType");
    for (const Media_Type& row : media_types)
    {
        if (std::strcmp(row.media, media) == 0)
            return row.port_type;
    }
    return 0;
}

} // namespace zmlr
