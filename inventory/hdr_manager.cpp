#include "inventory/hdr_manager.h"

#include "inventory/dispatch.h"
#include "runtime/log.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "HDRManager";

constexpr Route routes[] = {
    {CLASSID_StorageExtent, CLASSID_StorageExtent, Driver::needed, nullptr},
    {CLASSID_TapeDrive, CLASSID_TapeDrive, Driver::needed, nullptr},
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
    return dispatch(log_source, routes, id, request);
}

} // namespace zmlr
