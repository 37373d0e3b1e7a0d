#include "providers/ZEMLAR_AlarmDevice_Provider_Skeleton.h"
#include "providers/enumerate.h"

namespace zmlr
{

namespace
{

constexpr Enumeration source = {
    .log_source = "ZEMLAR_AlarmDevice_Provider",
    .id = CLASSID_AlarmDevice,
    .get_instances = from_fchba_manager,
    .empty_message = "Invalid number of Instances returned",
};

class ZEMLAR_AlarmDevice_Provider final : public ZEMLAR_AlarmDevice_Provider_Skeleton
{
public:
    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>& handler) override
    {
        return enumerate(source, handler);
    }
};

} // namespace

ZEMLAR_AlarmDevice_Provider_Skeleton* create_ZEMLAR_AlarmDevice_Provider() { return new ZEMLAR_AlarmDevice_Provider; }

} // namespace zmlr
