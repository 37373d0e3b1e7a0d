#include "providers/ZEMLAR_EthernetPort_Provider_Skeleton.h"
#include "providers/enumerate.h"

namespace zmlr
{

namespace
{

constexpr Enumeration source = {
    .log_source = "ZEMLAR_EthernetPort_Provider",
    .id = CLASSID_EthernetPort,
    .get_instances = from_fchba_manager,
    .empty_message = "Error: Invalid mapping information",
};

class ZEMLAR_EthernetPort_Provider final : public ZEMLAR_EthernetPort_Provider_Skeleton
{
public:
    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>& handler) override
    {
        return enumerate(source, handler);
    }
};

} // namespace

ZEMLAR_EthernetPort_Provider_Skeleton* create_ZEMLAR_EthernetPort_Provider() { return new ZEMLAR_EthernetPort_Provider; }

} // namespace zmlr
