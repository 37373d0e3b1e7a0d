// EthernetPortHelper: the instances that describe the Ethernet side of the ports of converged network adapters.
#pragma once

#include "inventory/class_id.h"
#include "inventory/inventory_request.h"
#include "runtime/instance.h"
#include "runtime/string.h"

namespace zmlr
{

class EthernetPortHelper
{
public:
    static const EthernetPortHelper& getEthernetPortHelperObject();

    // The class's instances of all CNAs, or of one adapter, in the order of adapters and ports. Reads the ports afresh (one
    // request for each port's attributes, and one for its module when ports are asked for); a port that cannot be read is
    // skipped with a log line.
    Instance_Array getInstancesByClass(classId_t id, const Inventory_Request& request = {}) const;
    Instance_Array getInstancesByAdapterId(int adapter, classId_t id, const Inventory_Request& request = {}) const;

    // The ZEMLAR_EthernetPort instances of the adapter with this MAC address; no other kind of address names one.
    Instance_Array getEthernetPortInstancesByAdapter(const String& mac, const Inventory_Request& request = {}) const;

private:
    EthernetPortHelper() = default;
};

} // namespace zmlr
