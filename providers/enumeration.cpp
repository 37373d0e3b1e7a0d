#include "providers/enumeration.h"

#include "inventory/fchba_manager.h"
#include "inventory/hdr_manager.h"

namespace zmlr
{

Instance_Array fchba_manager(classId_t id, const Inventory_Request& request)
{
    return FCHBAManager::getFCHBAManager().getInstances(id, request);
}

Instance_Array hdr_manager(classId_t id, const Inventory_Request& request)
{
    return HDRManager::getHDRManager().getInstances(id, request);
}

Instance_Array instances_of(const Enumeration& row, const char* log_source)
{
    Instance_Array instances = row.get_instances(row.id, Inventory_Request());
    if (!instances.empty())
    {
        ZMLR_LOG(LL_DBG, "Returning instances");
        return instances;
    }
    for (const Log_Row& line : row.empty)
    {
        if (line.text)
            ZMLR_LOG(line.level, "%s", line.text);
    }
    return instances;
}

} // namespace zmlr
