#include "providers/ZEMLAR_FCPort_Provider_Skeleton.h"
#include "providers/enumerate.h"

namespace zmlr
{

namespace
{

constexpr Enumeration source = {
    .log_source = "ZEMLAR_FCPort_Provider",
    .id = CLASSID_FCPort,
    .get_instances = from_fchba_manager,
    .empty_message = "No FC Ports Found!",
};

class ZEMLAR_FCPort_Provider final : public ZEMLAR_FCPort_Provider_Skeleton
{
public:
    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>& handler) override
    {
        return enumerate(source, handler);
    }
};

} // namespace

ZEMLAR_FCPort_Provider_Skeleton* create_ZEMLAR_FCPort_Provider() { return new ZEMLAR_FCPort_Provider; }

} // namespace zmlr
