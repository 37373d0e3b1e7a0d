#include "inventory/access_point_helper.h"

#include "inventory/property_text.h"
#include "inventory/provider_util.h"
#include "inventory/shell_command.h"
#include "runtime/log.h"
#include "runtime/trace.h"

#include <string>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "AccessPointHelper";

constexpr int agent_port = 34568;
constexpr std::chrono::seconds process_list_limit{10};

constexpr uint16 INFO_FORMAT_URL = 200; // CIM_RemoteServiceAccessPoint.InfoFormat

String web_address(const String& host, int port)
{
    return String("https://") + host + ":" + std::to_string(port).c_str() + "/index.html";
}

} // namespace

int ProviderUtil::getAgentPort()
{
    const Scope_Trace trace("ProviderUtil");
    First_Line process;
    run_shell_command("ps -e | grep quillonagent$", process_list_limit, &process);
    return process.text[0] == '\0' ? 0 : agent_port;
}

Ref<ZEMLAR_RemoteServiceAccessPoint> getRemoteServiceAccessPointInstance(const _hbaInfo& info)
{
    const Scope_Trace trace(log_source);
    const int port = ProviderUtil::getAgentPort();
    if (port == 0)
    {
        ZMLR_LOG(LL_INFO, "The Quillon Agent is not running so no service available");
        return Ref<ZEMLAR_RemoteServiceAccessPoint>();
    }
    const String host = property_text(info.host);
    Ref<ZEMLAR_RemoteServiceAccessPoint> access_point(ZEMLAR_RemoteServiceAccessPoint::create());
    access_point->SystemCreationClassName.set(ProviderUtil::getClassName(CLASSID_ComputerSystem));
    access_point->CreationClassName.set(ProviderUtil::getClassName(CLASSID_RemoteServiceAccessPoint));
    access_point->SystemName.set(host);
    access_point->Name.set("Quillon Service");
    access_point->ElementName.set("Quillon Service Access Point");
    access_point->InfoFormat.set(INFO_FORMAT_URL);
    access_point->AccessInfo.set(web_address(host, port));
    return access_point;
}

const AccessPointHelper& AccessPointHelper::getAccessPointHelperInstance()
{
    static constinit const AccessPointHelper helper;
    return helper;
}

Instance_Array AccessPointHelper::getInstancesByClass(classId_t, const Inventory_Request& request) const
{
    const Scope_Trace trace(log_source);
    Instance_Array instances;
    if (request.host.info() == HOST_LOCALHOST)
    {
        ZMLR_LOG(LL_WARN, "getHostInfo returned localhost");
        return instances;
    }
    _hbaInfo info;
    copy_text(info.host, request.host.text());
    Ref<ZEMLAR_RemoteServiceAccessPoint> access_point = getRemoteServiceAccessPointInstance(info);
    if (!access_point)
        return instances;
    instances.adopt(std::move(access_point));
    ZMLR_LOG(LL_INFO, "Number of instances: %d", static_cast<int>(instances.size()));
    return instances;
}

} // namespace zmlr
