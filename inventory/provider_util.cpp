#include "inventory/provider_util.h"

#include "inventory/provider_init.h"
#include "runtime/log.h"
#include "runtime/trace.h"

#include <sys/stat.h>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "ProviderUtil";

} // namespace

String ProviderUtil::getClassName(classId_t id)
{
    const Scope_Trace trace(log_source);
    ZMLR_LOG(LL_INFO, "ClassId = %d", static_cast<int>(id));
    String name = class_name(id);
    if (name.empty())
    {
        ZMLR_LOG(LL_INFO, "ClassId is greater than MAXCLASSID");
        return "INVALID CLASS";
    }
    ZMLR_LOG(LL_INFO, "Class = %s", name.c_str());
    return name;
}

bool ProviderUtil::getDriverStatus()
{
    const Scope_Trace trace(log_source);
    const Driver_Status status = ProviderInit::getDriverStatus();
    return status == DRIVER_GOOD || status == DRIVER_FAILURE;
}

bool ProviderUtil::IsFileExist(const char* path)
{
    const Scope_Trace trace(log_source);
    struct stat status;
    return stat(path, &status) == 0;
}

} // namespace zmlr
