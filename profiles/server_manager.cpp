#include "profiles/server_manager.h"

#include "inventory/dispatch.h"
#include "profiles/object_manager.h"
#include "profiles/profile_software_identity.h"
#include "profiles/registered_profiles.h"
#include "runtime/log.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "ServerManager";

Instance_Array registered(classId_t, const Inventory_Request&) { return getRegisteredProfileInstances(); }
Instance_Array subregistered(classId_t, const Inventory_Request&) { return getRegisteredSubProfileInstances(); }
Instance_Array software(classId_t, const Inventory_Request&) { return getProfileSoftwareIdentityInstances(); }

// clang-format off
constexpr Route routes[] = {
    {CLASSID_RegisteredProfile,            CLASSID_RegisteredProfile,            Driver::not_needed, registered},
    {CLASSID_RegisteredSubProfile,         CLASSID_RegisteredSubProfile,         Driver::not_needed, subregistered},
    {CLASSID_Namespace,                    CLASSID_Namespace,                    Driver::not_needed, getNamespaceInstances},
    {CLASSID_ObjectManager,                CLASSID_ObjectManager,                Driver::not_needed, getObjectManagerInstance},
    {CLASSID_CIMXMLCommunicationMechanism, CLASSID_CIMXMLCommunicationMechanism, Driver::not_needed, getCIMXMLCommunicationMechanismInstance},
    {CLASSID_ProfileSoftwareIdentity,      CLASSID_ProfileSoftwareIdentity,      Driver::not_needed, software},
};
// clang-format on

} // namespace

ServerManager::ServerManager()
{
    ZMLR_LOG(LL_INFO, "Inside ServerManager Constructor");
    ZMLR_LOG(LL_INFO, "Loading HBA API Library");
}

const ServerManager& ServerManager::getServerManager()
{
    static const ServerManager manager;
    return manager;
}

Instance_Array ServerManager::getInstances(classId_t id, const Inventory_Request& request) const
{
    return dispatch(log_source, routes, id, request);
}

} // namespace zmlr
