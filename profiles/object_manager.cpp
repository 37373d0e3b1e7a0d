#include "profiles/object_manager.h"

#include "inventory/cim_values.h"
#include "inventory/property_text.h"
#include "inventory/provider_util.h"
#include "profiles/own_object_manager.h"
#include "runtime/trace.h"
#include "schema/ZEMLAR_CIMXMLCommunicationMechanism.h"
#include "schema/ZEMLAR_Namespace.h"
#include "schema/ZEMLAR_ObjectManager.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "ServerManager";

// CIM_Namespace.ClassInfo and .ClassType
constexpr uint16 CLASS_INFO_CIM_2_8 = 11;
constexpr uint16 CLASS_TYPE_CIM = 2;

// CIM_ObjectManagerCommunicationMechanism
constexpr uint16 MECHANISM_CIM_XML = 2;
constexpr uint16 AUTHENTICATION_BASIC = 3;
constexpr uint16 BASIC_READ = 2, BASIC_WRITE = 3, SCHEMA_MANIPULATION = 4, INSTANCE_MANIPULATION = 5, ASSOCIATION_TRAVERSAL = 6,
                 QUALIFIER_DECLARATION = 8, INDICATIONS = 9;

// What a class shares with all that lives on the host: its keys.
template <class T> Ref<T> on_the_host(classId_t id, const Inventory_Request& request)
{
    Ref<T> instance(T::create());
    instance->SystemCreationClassName.set(ProviderUtil::getClassName(CLASSID_ComputerSystem));
    instance->SystemName.set(property_text(request.host.text()));
    instance->CreationClassName.set(ProviderUtil::getClassName(id));
    return instance;
}

template <class T> Instance_Array only(Ref<T> instance)
{
    Instance_Array instances;
    instances.adopt(std::move(instance));
    return instances;
}

} // namespace

Instance_Array getObjectManagerInstance(classId_t id, const Inventory_Request& request)
{
    const Scope_Trace trace(log_source);
    const auto own = own_object_manager();
    if (!own)
        return Instance_Array();
    auto manager = on_the_host<ZEMLAR_ObjectManager>(id, request);
    manager->Name.set(own->name);
    manager->Caption = own->element_name;
    manager->Description = own->description;
    manager->ElementName.set("CIM Server");
    manager->OperationalStatus.set({OPERATIONAL_STATUS_OK});
    manager->Started.set(true);
    return only(std::move(manager));
}

Instance_Array getNamespaceInstances(classId_t id, const Inventory_Request& request)
{
    const Scope_Trace trace(log_source);
    const auto own = own_object_manager();
    if (!own)
        return Instance_Array();
    auto name_space = on_the_host<ZEMLAR_Namespace>(id, request);
    name_space->ObjectManagerCreationClassName.set(ProviderUtil::getClassName(CLASSID_ObjectManager));
    name_space->ObjectManagerName.set(own->name);
    name_space->Name.set("root/zemlar");
    name_space->ClassInfo.set(CLASS_INFO_CIM_2_8);
    name_space->ClassType.set(CLASS_TYPE_CIM);
    name_space->ClassTypeVersion.set("2.23.0");
    return only(std::move(name_space));
}

Instance_Array getCIMXMLCommunicationMechanismInstance(classId_t id, const Inventory_Request& request)
{
    const Scope_Trace trace(log_source);
    auto mechanism = on_the_host<ZEMLAR_CIMXMLCommunicationMechanism>(id, request);
    mechanism->Name.set("CIM-XML");
    mechanism->ElementName.set("CIM-XML Communication Mechanism");
    mechanism->CommunicationMechanism.set(MECHANISM_CIM_XML);
    mechanism->Version.set("1.2");
    mechanism->CIMValidated.set(true);
    mechanism->MultipleOperationsSupported.set(true);
    mechanism->FunctionalProfilesSupported.set({BASIC_READ, BASIC_WRITE, SCHEMA_MANIPULATION, INSTANCE_MANIPULATION,
                                                ASSOCIATION_TRAVERSAL, QUALIFIER_DECLARATION, INDICATIONS});
    mechanism->AuthenticationMechanismsSupported.set({AUTHENTICATION_BASIC});
    mechanism->OperationalStatus.set({OPERATIONAL_STATUS_OK});
    return only(std::move(mechanism));
}

} // namespace zmlr
