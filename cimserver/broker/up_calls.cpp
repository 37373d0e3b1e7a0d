// The broker's own table: attaching threads, and requests that a provider sends back through the server.
#include "cimserver/broker/broker.h"
#include "cimserver/broker/objects.h"
#include "cimserver/broker/return_code.h"
#include "cimserver/operations.h"

#include <memory>
#include <vector>

namespace cimserver
{
namespace
{

// The arenas of this thread's attachments, innermost last.
thread_local std::vector<std::unique_ptr<Arena>> attachments;

// Nobody owns the context until the thread it is for detaches.
CMPIContext* prepare_attach_thread(const CMPIBroker* broker, const CMPIContext* context) noexcept
{
    return answer<CMPIContext*>(nullptr, nullptr,
                                [&]
                                {
                                    broker_of(broker);
                                    return (new Context_Object(object<Context_Object>(context)))->face();
                                });
}

CMPIStatus attach_thread(const CMPIBroker* broker, const CMPIContext* context) noexcept
{
    return answer(
        [&]
        {
            broker_of(broker);
            object<Context_Object>(context);
            attachments.push_back(std::make_unique<Arena>());
        });
}

CMPIStatus detach_thread(const CMPIBroker* broker, const CMPIContext* context) noexcept
{
    return answer(
        [&]
        {
            broker_of(broker);
            auto& prepared = object<Context_Object>(context);
            if (attachments.empty() || attachments.back().get() != Arena::current())
                throw Failure{CMPI_RC_ERR_FAILED};
            if (!prepared.owned())
                delete &prepared;
            attachments.pop_back();
        });
}

// Runs an operation of the server for a provider.
template <class Body> auto up_call(const CMPIBroker* broker, const CMPIContext* context, Body body)
{
    object<Context_Object>(context);
    try
    {
        return body(broker_of(broker).operations());
    }
    catch (const Cim_Error& error)
    {
        throw Failure{return_code(error.code())};
    }
}

Property_List property_list(const char** properties)
{
    if (!properties)
        return std::nullopt;
    std::vector<std::string> names;
    for (; *properties; ++properties)
        names.emplace_back(*properties);
    return names;
}

template <class T> CMPIEnumeration* enumeration(CMPIType type, std::vector<T> found)
{
    std::vector<Value> elements(found.size(), Value{type, {}});
    for (std::size_t i = 0; i < found.size(); ++i)
        elements[i].content = std::make_shared<const T>(std::move(found[i]));
    return make<Enumeration_Object>(type, std::move(elements)).face();
}

CMPIEnumeration* enumerate_instance_names(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* self,
                                          CMPIStatus* status) noexcept
{
    return answer<CMPIEnumeration*>(status, nullptr,
                                    [&]
                                    {
                                        const Object_Path& path = object<Path_Object>(self).path;
                                        return enumeration(CMPI_ref, up_call(broker, context,
                                                                             [&](Operations& operations) {
                                                                                 return operations.enumerate_instance_names(
                                                                                     path.name_space, path.class_name);
                                                                             }));
                                    });
}

CMPIEnumeration* enumerate_instances(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* self,
                                     const char** properties, CMPIStatus* status) noexcept
{
    return answer<CMPIEnumeration*>(status, nullptr,
                                    [&]
                                    {
                                        const Object_Path& path = object<Path_Object>(self).path;
                                        return enumeration(CMPI_instance, up_call(broker, context,
                                                                                  [&](Operations& operations) {
                                                                                      return operations.enumerate_instances(
                                                                                          path.name_space, path.class_name, true,
                                                                                          property_list(properties));
                                                                                  }));
                                    });
}

CMPIInstance* get_instance(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* self,
                           const char** properties, CMPIStatus* status) noexcept
{
    return answer<CMPIInstance*>(status, nullptr,
                                 [&]
                                 {
                                     const Object_Path& path = object<Path_Object>(self).path;
                                     const Instance found =
                                         up_call(broker, context,
                                                 [&](Operations& operations)
                                                 { return operations.get_instance(path, property_list(properties)); });
                                     return make<Instance_Object>(found).face();
                                 });
}

CMPIStatus deliver_indication(const CMPIBroker* broker, const CMPIContext* context, const char* name_space,
                              const CMPIInstance* indication) noexcept
{
    return answer(
        [&]
        {
            object<Context_Object>(context);
            const auto& instance = object<Instance_Object>(indication);
            broker_of(broker).indication_sink().deliver(required(name_space), instance.model());
        });
}

CMPIObjectPath* create_instance(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const CMPIInstance*,
                                CMPIStatus* status) noexcept
{
    return not_supported<CMPIObjectPath*>(status, nullptr);
}

CMPIStatus modify_instance(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const CMPIInstance*,
                           const char**) noexcept
{
    return not_supported();
}

CMPIStatus delete_instance(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*) noexcept { return not_supported(); }

CMPIEnumeration* exec_query(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char*, const char*,
                            CMPIStatus* status) noexcept
{
    return not_supported<CMPIEnumeration*>(status, nullptr);
}

CMPIEnumeration* associators(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char*, const char*, const char*,
                             const char*, const char**, CMPIStatus* status) noexcept
{
    return not_supported<CMPIEnumeration*>(status, nullptr);
}

CMPIEnumeration* associator_names(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char*, const char*,
                                  const char*, const char*, CMPIStatus* status) noexcept
{
    return not_supported<CMPIEnumeration*>(status, nullptr);
}

CMPIEnumeration* references(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char*, const char*, const char**,
                            CMPIStatus* status) noexcept
{
    return not_supported<CMPIEnumeration*>(status, nullptr);
}

CMPIEnumeration* reference_names(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char*, const char*,
                                 CMPIStatus* status) noexcept
{
    return not_supported<CMPIEnumeration*>(status, nullptr);
}

CMPIData invoke_method(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char*, const CMPIArgs*, CMPIArgs*,
                       CMPIStatus* status) noexcept
{
    return not_supported(status, no_data());
}

CMPIStatus set_property(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char*, const CMPIValue*,
                        CMPIType) noexcept
{
    return not_supported();
}

CMPIData get_property(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char*, CMPIStatus* status) noexcept
{
    return not_supported(status, no_data());
}

} // namespace

const CMPIBrokerFT broker_table = {
    .brokerCapabilities = 0,
    .brokerVersion = 100,
    .brokerName = "zmlr-cimserver",
    .prepareAttachThread = prepare_attach_thread,
    .attachThread = attach_thread,
    .detachThread = detach_thread,
    .deliverIndication = deliver_indication,
    .enumerateInstanceNames = enumerate_instance_names,
    .getInstance = get_instance,
    .createInstance = create_instance,
    .modifyInstance = modify_instance,
    .deleteInstance = delete_instance,
    .execQuery = exec_query,
    .enumerateInstances = enumerate_instances,
    .associators = associators,
    .associatorNames = associator_names,
    .references = references,
    .referenceNames = reference_names,
    .invokeMethod = invoke_method,
    .setProperty = set_property,
    .getProperty = get_property,
};

} // namespace cimserver
