// PortHelper: the instances that describe one FC port of an adapter (on a CNA: the FCoE side of a port).
#pragma once

#include "inventory/class_id.h"
#include "inventory/inventory_request.h"
#include "runtime/instance.h"
#include "runtime/string.h"

namespace zmlr
{

class PortHelper
{
public:
    static const PortHelper& getPortHelperObject();

    // The class's instances of all adapters, or of one, in the order of adapters and ports. Reads the ports afresh (one
    // request for each port's attributes); an adapter or port that cannot be read is skipped with a log line.
    Instance_Array getInstancesByClass(classId_t id, const Inventory_Request& request = {}) const;
    Instance_Array getInstancesByAdapterId(int adapter, classId_t id, const Inventory_Request& request = {}) const;

    // The ZEMLAR_FCPort instances of the adapter with this MAC address or node WWN.
    Instance_Array getFCPortInstancesByAdapter(const String& address, const Inventory_Request& request = {}) const;

private:
    PortHelper() = default;
};

} // namespace zmlr
