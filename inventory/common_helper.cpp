#include "inventory/common_helper.h"

#include "inventory/cim_values.h"
#include "inventory/property_text.h"
#include "inventory/provider_util.h"
#include "runtime/log.h"
#include "runtime/trace.h"
#include "schema/ZEMLAR_ComputerSystem.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "CommonHelper";

// CIM_ComputerSystem.Dedicated
constexpr uint16 NOT_DEDICATED = 0;
constexpr uint16 MANAGEMENT = 14;

void identify(ZEMLAR_ComputerSystem& system, const String& host, const char* format, const char* description)
{
    system.NameFormat.set(format);
    system.OtherIdentifyingInfo.set({host});
    system.IdentifyingDescriptions.set({description});
}

void identify(ZEMLAR_ComputerSystem& system, const String& host, Host_Info info)
{
    switch (info)
    {
    case HOST_IP_ADDRESS:
        identify(system, host, "IP", "Ipv4 Address");
        return;
    case HOST_LOCALHOST:
        ZMLR_LOG(LL_WARN, "No host IP / Name  retrived in the function, So function fills localhost for host info.");
        [[fallthrough]];
    case HOST_NAME:
    case HOST_FULL_NAME:
        identify(system, host, "Other", "Fully Qualified Domain Name");
        return;
    }
    ZMLR_LOG(LL_INFO, "Entered Default case ");
}

} // namespace

const CommonHelper& CommonHelper::getCommonHelperObject()
{
    static constinit const CommonHelper helper;
    return helper;
}

Instance_Array CommonHelper::getComputerSystemInstances(classId_t id, const Inventory_Request& request) const
{
    const Scope_Trace trace(log_source);
    const String description = "The host with Zemlar's adapters installed.";
    const String host = property_text(request.host.text());

    Ref<ZEMLAR_ComputerSystem> system(ZEMLAR_ComputerSystem::create());
    system->Name.set(host);
    system->CreationClassName.set(ProviderUtil::getClassName(id));
    identify(*system.ptr(), host, request.host.info());
    system->ElementName.set(description);
    system->Description.set(description);
    system->Caption.set(description);
    system->Dedicated.set({NOT_DEDICATED, MANAGEMENT});
    system->OperationalStatus.set({OPERATIONAL_STATUS_OK});
    system->StatusDescriptions.set({"The System is in service"});

    Instance_Array instances;
    instances.adopt(Ref<Instance>(system.steal()));
    return instances;
}

} // namespace zmlr
