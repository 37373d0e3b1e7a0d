#include "providers/ZEMLAR_HBASoftwareInstallationService_Provider_Skeleton.h"
#include "providers/enumerate.h"

namespace zmlr
{

namespace
{

constexpr Enumeration source = {
    .log_source = "ZEMLAR_HBASoftwareInstallationService_Provider",
    .id = CLASSID_HBASoftwareInstallationService,
    .get_instances = from_fchba_manager,
    .empty_message = "Error: Invalid mapping information",
};

class ZEMLAR_HBASoftwareInstallationService_Provider final : public ZEMLAR_HBASoftwareInstallationService_Provider_Skeleton
{
public:
    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>& handler) override
    {
        return enumerate(source, handler);
    }
};

} // namespace

ZEMLAR_HBASoftwareInstallationService_Provider_Skeleton* create_ZEMLAR_HBASoftwareInstallationService_Provider()
{
    return new ZEMLAR_HBASoftwareInstallationService_Provider;
}

} // namespace zmlr
