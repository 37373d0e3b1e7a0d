#include "providers/ZEMLAR_ComputerSystem_Provider_Skeleton.h"
#include "providers/enumerate.h"

namespace zmlr
{

namespace
{

constexpr Enumeration source = {
    .log_source = "ZEMLAR_ComputerSystem_Provider",
    .id = CLASSID_ComputerSystem,
    .get_instances = from_fchba_manager,
    .empty_message = "Error: Invalid mapping information",
};

class ZEMLAR_ComputerSystem_Provider final : public ZEMLAR_ComputerSystem_Provider_Skeleton
{
public:
    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>& handler) override
    {
        return enumerate(source, handler);
    }
};

} // namespace

ZEMLAR_ComputerSystem_Provider_Skeleton* create_ZEMLAR_ComputerSystem_Provider() { return new ZEMLAR_ComputerSystem_Provider; }

} // namespace zmlr
