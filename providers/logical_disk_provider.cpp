#include "providers/ZEMLAR_LogicalDisk_Provider_Skeleton.h"

namespace zmlr
{

namespace
{

// The disks of the fabric are published as ZEMLAR_StorageExtent; of this class there are none.
class ZEMLAR_LogicalDisk_Provider final : public ZEMLAR_LogicalDisk_Provider_Skeleton
{
public:
    Enum_Instances_Status enum_instances(const ZEMLAR_LogicalDisk*, Enum_Instances_Handler<ZEMLAR_LogicalDisk>&) override
    {
        return ENUM_INSTANCES_OK;
    }
};

} // namespace

ZEMLAR_LogicalDisk_Provider_Skeleton* create_ZEMLAR_LogicalDisk_Provider() { return new ZEMLAR_LogicalDisk_Provider; }

} // namespace zmlr
