#include "providers/ZEMLAR_Product_Provider_Skeleton.h"
#include "providers/enumerate.h"

namespace zmlr
{

namespace
{

constexpr Enumeration source = {
    .log_source = "ZEMLAR_Product_Provider",
    .id = CLASSID_Product,
    .get_instances = from_fchba_manager,
    .empty_message = "No Adapter Found!",
};

class ZEMLAR_Product_Provider final : public ZEMLAR_Product_Provider_Skeleton
{
public:
    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>& handler) override
    {
        return enumerate(source, handler);
    }
};

} // namespace

ZEMLAR_Product_Provider_Skeleton* create_ZEMLAR_Product_Provider() { return new ZEMLAR_Product_Provider; }

} // namespace zmlr
