// AdapterHelper: the instances that describe an adapter as a whole.
#pragma once

#include "inventory/class_id.h"
#include "inventory/hba_info.h"
#include "runtime/instance.h"
#include "schema/ZEMLAR_PortController.h"

namespace zmlr
{

class AdapterHelper
{
public:
    static const AdapterHelper& getAdapterHelperInstance();

    // The class's instances over all adapters, in their order. Reads the adapters afresh; one that cannot be read is skipped
    // with a log line.
    Instance_Array getInstancesByClass(classId_t id) const;

    // The adapter's controller, from a complete record.
    static Ref<ZEMLAR_PortController> getPortControllerInstance(const _hbaInfo& info);

private:
    AdapterHelper() = default;
};

} // namespace zmlr
