#include "providers/ZEMLAR_RemoteServiceAccessPoint_Provider_Skeleton.h"
#include "providers/enumerate.h"

namespace zmlr
{

namespace
{

constexpr Enumeration source = {
    .log_source = "ZEMLAR_RemoteServiceAccessPoint_Provider",
    .id = CLASSID_RemoteServiceAccessPoint,
    .get_instances = from_fchba_manager,
    .empty_message = "Error: Invalid mapping information",
    .empty_remark = "Warning: No service is available",
};

class ZEMLAR_RemoteServiceAccessPoint_Provider final : public ZEMLAR_RemoteServiceAccessPoint_Provider_Skeleton
{
public:
    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>& handler) override
    {
        return enumerate(source, handler);
    }
};

} // namespace

ZEMLAR_RemoteServiceAccessPoint_Provider_Skeleton* create_ZEMLAR_RemoteServiceAccessPoint_Provider()
{
    return new ZEMLAR_RemoteServiceAccessPoint_Provider;
}

} // namespace zmlr
