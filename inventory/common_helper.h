// CommonHelper: the host itself.
#pragma once

#include "inventory/class_id.h"
#include "inventory/inventory_request.h"
#include "runtime/instance.h"

namespace zmlr
{

class CommonHelper
{
public:
    static const CommonHelper& getCommonHelperObject();

    // Exactly one ZEMLAR_ComputerSystem, with or without a driver; its CreationClassName is the name of `id`.
    Instance_Array getComputerSystemInstances(classId_t id, const Inventory_Request& request = {}) const;

private:
    CommonHelper() = default;
};

} // namespace zmlr
