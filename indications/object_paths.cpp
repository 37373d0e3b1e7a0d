#include "indications/object_paths.h"

#include "inventory/host_text.h"
#include "inventory/provider_util.h"
#include "runtime/model_path.h"
#include "runtime/trace.h"
#include "schema/ZEMLAR_ComputerSystem.h"
#include "schema/ZEMLAR_EthernetPort.h"
#include "schema/ZEMLAR_FCPort.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "IndicationHelper";

String path_of(const Instance* object, const String& host)
{
    String path;
    instance_to_model_path(object, path);
    return ProviderUtil::updateNamespacePath(path, host);
}

template <class Port> String port_path(classId_t id, const String& host, const String& address)
{
    const Ref<Port> port(Port::create());
    port->SystemCreationClassName.set(ProviderUtil::getClassName(CLASSID_ComputerSystem));
    port->SystemName.set(host);
    port->CreationClassName.set(ProviderUtil::getClassName(id));
    port->DeviceID.set(address);
    return path_of(port.ptr(), host);
}

} // namespace

String getComputerSystemObjectPath(const String& host)
{
    const Scope_Trace trace(log_source);
    const Ref<ZEMLAR_ComputerSystem> system(ZEMLAR_ComputerSystem::create());
    system->Name.set(host);
    system->CreationClassName.set(ProviderUtil::getClassName(CLASSID_ComputerSystem));
    return path_of(system.ptr(), host);
}

String getFCPortObjectPath(const String& host, const String& wwn)
{
    const Scope_Trace trace(log_source);
    return port_path<ZEMLAR_FCPort>(CLASSID_FCPort, host, wwn);
}

String getEthernetPortObjectPath(const String& host, const String& mac)
{
    const Scope_Trace trace(log_source);
    return port_path<ZEMLAR_EthernetPort>(CLASSID_EthernetPort, host, mac);
}

} // namespace zmlr
