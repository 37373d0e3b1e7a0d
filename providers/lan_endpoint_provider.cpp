#include "providers/ZEMLAR_LANEndpoint_Provider_Skeleton.h"
#include "providers/enumerate.h"

namespace zmlr
{

namespace
{

constexpr Enumeration source = {
    .log_source = "ZEMLAR_LANEndpoint_Provider",
    .id = CLASSID_LANEndpoint,
    .get_instances = from_fchba_manager,
    .empty_message = "No Ethernet Port Found",
};

class ZEMLAR_LANEndpoint_Provider final : public ZEMLAR_LANEndpoint_Provider_Skeleton
{
public:
    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>& handler) override
    {
        return enumerate(source, handler);
    }
};

} // namespace

ZEMLAR_LANEndpoint_Provider_Skeleton* create_ZEMLAR_LANEndpoint_Provider() { return new ZEMLAR_LANEndpoint_Provider; }

} // namespace zmlr
