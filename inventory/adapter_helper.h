// AdapterHelper: the instances that describe an adapter as a whole.
#pragma once

#include "inventory/class_id.h"
#include "inventory/inventory_request.h"
#include "runtime/instance.h"

namespace zmlr
{

class AdapterHelper
{
public:
    static const AdapterHelper& getAdapterHelperInstance();

    // The class's instances over all adapters, in their order. Reads the adapters afresh; one that cannot be read is skipped
    // with a log line.
    Instance_Array getInstancesByClass(classId_t id, const Inventory_Request& request = {}) const;

private:
    AdapterHelper() = default;
};

} // namespace zmlr
