#include "providers/ZEMLAR_FCPortStatistics_Provider_Skeleton.h"
#include "providers/enumerate.h"

namespace zmlr
{

namespace
{

constexpr Enumeration source = {
    .log_source = "ZEMLAR_FCPortStatistics_Provider",
    .id = CLASSID_FCPortStatistics,
    .get_instances = from_fchba_manager,
    .empty_message = "No FC Ports Found!",
};

class ZEMLAR_FCPortStatistics_Provider final : public ZEMLAR_FCPortStatistics_Provider_Skeleton
{
public:
    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>& handler) override
    {
        return enumerate(source, handler);
    }
};

} // namespace

ZEMLAR_FCPortStatistics_Provider_Skeleton* create_ZEMLAR_FCPortStatistics_Provider()
{
    return new ZEMLAR_FCPortStatistics_Provider;
}

} // namespace zmlr
