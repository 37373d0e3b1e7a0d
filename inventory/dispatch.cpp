#include "inventory/dispatch.h"

#include "inventory/provider_util.h"
#include "runtime/log.h"
#include "runtime/trace.h"

#include <algorithm>

namespace zmlr
{

Instance_Array dispatch(const char* log_source, std::span<const Route> routes, classId_t id, const Inventory_Request& request)
{
    const Scope_Trace trace(log_source, "getInstances");
    ZMLR_LOG(LL_INFO, "Requested classId : %d", static_cast<int>(id));
    ZMLR_LOG(LL_INFO, "Requested class is: %s", ProviderUtil::getClassName(id).c_str());

    const bool gate_open = ProviderUtil::getDriverStatus();
    const auto route = std::ranges::find_if(routes, [id](const Route& r) { return r.first <= id && id <= r.last; });
    if (route == routes.end())
    {
        ZMLR_LOG(LL_INFO, "Requested class is NOT supported.");
        return Instance_Array();
    }
    if (route->driver == Driver::needed && !gate_open)
    {
        ZMLR_LOG(LL_ERR, "Driver is not installed or there is a hxal mismatch hence no instances returned");
        return Instance_Array();
    }
    return route->build(id, request);
}

} // namespace zmlr
