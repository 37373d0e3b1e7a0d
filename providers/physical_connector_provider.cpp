#include "providers/ZEMLAR_PhysicalConnector_Provider_Skeleton.h"
#include "providers/enumerate.h"

namespace zmlr
{

namespace
{

constexpr Enumeration source = {
    .log_source = "ZEMLAR_PhysicalConnector_Provider",
    .id = CLASSID_PhysicalConnector,
    .get_instances = from_fchba_manager,
    .empty_message = "No Connector Found!",
};

class ZEMLAR_PhysicalConnector_Provider final : public ZEMLAR_PhysicalConnector_Provider_Skeleton
{
public:
    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>& handler) override
    {
        return enumerate(source, handler);
    }
};

} // namespace

ZEMLAR_PhysicalConnector_Provider_Skeleton* create_ZEMLAR_PhysicalConnector_Provider()
{
    return new ZEMLAR_PhysicalConnector_Provider;
}

} // namespace zmlr
