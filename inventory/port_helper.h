// PortHelper: the instances that describe one FC port of an adapter (on a CNA: the FCoE side of a port).
#pragma once

#include "hxal/hxal.h"
#include "inventory/class_id.h"
#include "runtime/instance.h"
#include "runtime/string.h"
#include "schema/ZEMLAR_FCPort.h"

namespace zmlr
{

// What the driver tells about one FC port. Texts are zero-terminated, and as the driver delivered them.
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

class PortHelper
{
public:
    static const PortHelper& getPortHelperObject();

    // The class's instances of all adapters, or of one, in the order of adapters and ports. Reads the ports afresh (one
    // request for each port's attributes); an adapter or port that cannot be read is skipped with a log line.
    Instance_Array getInstancesByClass(classId_t id) const;
    Instance_Array getInstancesByAdapterId(int adapter, classId_t id) const;

    // The ZEMLAR_FCPort instances of the adapter with this MAC address or node WWN.
    Instance_Array getFCPortInstancesByAdapter(const String& address) const;

    static Ref<ZEMLAR_FCPort> getFCPortInstance(const _hbaPortInfo& info);

    // CIM OperationalStatus and PortType for what the driver says.
    static uint16 getPortState(uint32 port_state);
    static uint16 getPortType(uint32 port_type);

private:
    PortHelper() = default;
};

} // namespace zmlr
