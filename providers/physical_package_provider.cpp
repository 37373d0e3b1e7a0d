#include "providers/ZEMLAR_PhysicalPackage_Provider_Skeleton.h"
#include "providers/enumerate.h"

namespace zmlr
{

namespace
{

constexpr Enumeration source = {
    .log_source = "ZEMLAR_PhysicalPackage_Provider",
    .id = CLASSID_PhysicalPackage,
    .get_instances = from_fchba_manager,
    .empty_message = "No Adapter Found!",
};

class ZEMLAR_PhysicalPackage_Provider final : public ZEMLAR_PhysicalPackage_Provider_Skeleton
{
public:
    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>& handler) override
    {
        return enumerate(source, handler);
    }
};

} // namespace

ZEMLAR_PhysicalPackage_Provider_Skeleton* create_ZEMLAR_PhysicalPackage_Provider() { return new ZEMLAR_PhysicalPackage_Provider; }

} // namespace zmlr
