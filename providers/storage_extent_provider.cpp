#include "providers/ZEMLAR_StorageExtent_Provider_Skeleton.h"
#include "providers/enumerate.h"

namespace zmlr
{

namespace
{

constexpr Enumeration source = {
    .log_source = "ZEMLAR_StorageExtent_Provider",
    .id = CLASSID_StorageExtent,
    .get_instances = from_hdr_manager,
    .empty_message = "No StorageExtents Found!",
};

class ZEMLAR_StorageExtent_Provider final : public ZEMLAR_StorageExtent_Provider_Skeleton
{
public:
    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>& handler) override
    {
        return enumerate(source, handler);
    }
};

} // namespace

ZEMLAR_StorageExtent_Provider_Skeleton* create_ZEMLAR_StorageExtent_Provider() { return new ZEMLAR_StorageExtent_Provider; }

} // namespace zmlr
