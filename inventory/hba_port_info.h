// _hbaPortInfo: what the driver tells about one FC port, and how it gets there from the port's attributes.
#pragma once

#include "hxal/hxal.h"
#include "runtime/types.h"

namespace zmlr
{

// Texts are zero-terminated, and as the driver delivered them: property_text() makes properties of them.
struct _hbaPortInfo
{
    char address[50] = {}; // of the port its WWN; has room for a target endpoint's "<port WWN>_<remote port WWN>"
    char node_wwn[24] = {};
    char symbolic_name[256] = {};
    uint16 operational_status = 0; // CIM OperationalStatus
    char host[256] = {};
    char port_wwn[24] = {};
    uint16 port_type = 0;      // CIM FC PortType
    uint64 max_frame_size = 0; // bytes
    uint64 speed = 0;          // bit/s
    uint64 max_speed = 0;      // bit/s
    uint16 port_index = 0;     // on its adapter, from 0
};

// Fills a new record but for the host.
void fill_port(_hbaPortInfo& info, const hxa_pport_attr_t& attributes, int port_index);

} // namespace zmlr
