// HDRManager: the way from providers to the storage that is reached through the FC ports.
#pragma once

#include "inventory/class_id.h"
#include "inventory/inventory_request.h"
#include "runtime/instance.h"

namespace zmlr
{

class HDRManager
{
public:
    static const HDRManager& getHDRManager();

    // All instances of ZEMLAR_StorageExtent or ZEMLAR_TapeDrive; as FCHBAManager::getInstances.
    Instance_Array getInstances(classId_t id, const Inventory_Request& request = {}) const;

private:
    HDRManager();
};

} // namespace zmlr
