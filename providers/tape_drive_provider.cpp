#include "providers/ZEMLAR_TapeDrive_Provider_Skeleton.h"
#include "providers/enumerate.h"

namespace zmlr
{

namespace
{

constexpr Enumeration source = {
    .log_source = "ZEMLAR_TapeDrive_Provider",
    .id = CLASSID_TapeDrive,
    .get_instances = from_hdr_manager,
    .empty_message = "No TapeDrives Found!",
};

class ZEMLAR_TapeDrive_Provider final : public ZEMLAR_TapeDrive_Provider_Skeleton
{
public:
    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>& handler) override
    {
        return enumerate(source, handler);
    }
};

} // namespace

ZEMLAR_TapeDrive_Provider_Skeleton* create_ZEMLAR_TapeDrive_Provider() { return new ZEMLAR_TapeDrive_Provider; }

} // namespace zmlr
