#include "providers/ZEMLAR_PortController_Provider_Skeleton.h"
#include "providers/enumerate.h"

namespace zmlr
{

namespace
{

constexpr Enumeration source = {
    .log_source = "ZEMLAR_PortController_Provider",
    .id = CLASSID_PortController,
    .get_instances = from_fchba_manager,
    .empty_message = "No Adapter Found!",
};

class ZEMLAR_PortController_Provider final : public ZEMLAR_PortController_Provider_Skeleton
{
public:
    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>& handler) override
    {
        return enumerate(source, handler);
    }
};

} // namespace

ZEMLAR_PortController_Provider_Skeleton* create_ZEMLAR_PortController_Provider() { return new ZEMLAR_PortController_Provider; }

} // namespace zmlr
