#include "providers/ZEMLAR_LogicalPortGroup_Provider_Skeleton.h"
#include "providers/enumerate.h"

namespace zmlr
{

namespace
{

constexpr Enumeration source = {
    .log_source = "ZEMLAR_LogicalPortGroup_Provider",
    .id = CLASSID_LogicalPortGroup,
    .get_instances = from_fchba_manager,
    .empty_message = "No Logical Port Groups found!",
};

class ZEMLAR_LogicalPortGroup_Provider final : public ZEMLAR_LogicalPortGroup_Provider_Skeleton
{
public:
    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>& handler) override
    {
        return enumerate(source, handler);
    }
};

} // namespace

ZEMLAR_LogicalPortGroup_Provider_Skeleton* create_ZEMLAR_LogicalPortGroup_Provider()
{
    return new ZEMLAR_LogicalPortGroup_Provider;
}

} // namespace zmlr
