// _ethPortInfo: what the driver tells about the Ethernet side of one converged port.
#pragma once

#include "hxal/hxal.h"
#include "runtime/types.h"

namespace zmlr
{

// Texts are zero-terminated, and as the driver delivered them: property_text() makes properties of them.
struct _ethPortInfo
{
    char mac[13] = {};
    char interface_name[64] = {};  // the host's network interface
    uint16 operational_status = 0; // CIM OperationalStatus
    char host[64] = {};            // a longer text is cut
    char permanent_mac[13] = {};
    uint16 port_type = 0;  // CIM Ethernet PortType
    uint16 port_index = 0; // on its adapter, from 0
    uint32 mtu = 0;        // bytes
};

// Fills a new record but for host and type; name and MAC address are the library's, as the scan found them.
void fill_ethernet_port(_ethPortInfo& info, const hxal_t* ethernet, const hxa_ethport_attr_t& attributes, int port_index);

// CIM_EthernetPort.PortType for the media that a module complies with (ethernet_media()); 0 for several ones, and for none.
uint16 getEthernetPortType(const char* media);

} // namespace zmlr
