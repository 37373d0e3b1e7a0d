// PhysicalAssetHelper: the instances that describe the pluggable modules in the ports of all adapters.
#pragma once

#include "inventory/class_id.h"
#include "inventory/inventory_request.h"
#include "runtime/instance.h"

namespace zmlr
{

class PhysicalAssetHelper
{
public:
    static const PhysicalAssetHelper& getPhysicalAssetHelperObject();

    // The ZEMLAR_PhysicalConnector instances, in the order of adapters and ports. Reads the memory of each port's module (one
    // request, on a CNA to the port's Ethernet side); a port without a module is skipped with a log line.
    Instance_Array getInstancesByClass(classId_t id, const Inventory_Request& request = {}) const;

private:
    PhysicalAssetHelper() = default;
};

} // namespace zmlr
