#include "inventory/hdr_manager.h"

#include "inventory/dispatch.h"
#include "inventory/port_helper.h"
#include "runtime/log.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "HDRManager";

Instance_Array storage(classId_t id, const Inventory_Request& request)
{
    return PortHelper::getPortHelperObject().getInstancesByClass(id, request);
}

constexpr Route storage_routes[] = {
    {CLASSID_StorageExtent, CLASSID_StorageExtent, Driver::needed, storage},
    {CLASSID_TapeDrive, CLASSID_TapeDrive, Driver::needed, storage},
};

} // namespace

HDRManager::HDRManager() { ZMLR_LOG(LL_INFO, "Inside HDRManager Constructor"); }

const HDRManager& HDRManager::getHDRManager()
{
    static const HDRManager manager;
    return manager;
}

Instance_Array HDRManager::getInstances(classId_t id, const Inventory_Request& request) const
{
    return dispatch(log_source, storage_routes, id, request);
}

} // namespace zmlr
