// The broker's own table: attaching threads, and what providers read through the server.
#include "cimserver/broker/broker.h"
#include "cimserver/broker/cmpi_values.h"
#include "cimserver/broker/not_offered.h"
#include "cimserver/broker/objects.h"
#include "cimserver/broker/return_code.h"
#include "cimserver/model/operations.h"

#include <memory>
#include <utility>
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

// Runs an operation of the server for a provider: body(operations, path).
template <class Body>
auto up_call(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* self, const Body& body)
{
    object<Context_Object>(context);
    const Object_Path& path = object<Path_Object>(self).path;
    try
    {
        return body(broker_of(broker).name_spaces().at(path), path);
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

CMPIEnumeration* enumeration(std::vector<Instance> found)
{
    std::vector<Value> elements;
    for (Instance& instance : found)
        elements.push_back({CMPI_instance, std::move(instance)});
    return make<Enumeration_Object>(std::move(elements)).face();
}

CMPIEnumeration* enumerate_instances(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* self,
                                     const char** properties, CMPIStatus* status) noexcept
{
    const auto call = [&](Operations& operations, const Object_Path& path)
    { return operations.enumerate_instances(path.class_name, true, property_list(properties)); };
    return answer<CMPIEnumeration*>(status, nullptr, [&] { return enumeration(up_call(broker, context, self, call)); });
}

CMPIInstance* get_instance(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* self,
                           const char** properties, CMPIStatus* status) noexcept
{
    const auto call = [&](Operations& operations, const Object_Path& path)
    { return operations.get_instance(path, property_list(properties)); };
    return answer<CMPIInstance*>(status, nullptr,
                                 [&] { return make<Instance_Object>(up_call(broker, context, self, call)).face(); });
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

} // namespace

const CMPIBrokerFT broker_table = {
    .brokerCapabilities = 0,
    .brokerVersion = 100,
    .brokerName = "zmlr-cimserver",
    .prepareAttachThread = prepare_attach_thread,
    .attachThread = attach_thread,
    .detachThread = detach_thread,
    .deliverIndication = deliver_indication,
    .enumerateInstanceNames = not_offered,
    .getInstance = get_instance,
    .createInstance = not_offered,
    .modifyInstance = not_offered,
    .deleteInstance = not_offered,
    .execQuery = not_offered,
    .enumerateInstances = enumerate_instances,
    .associators = not_offered,
    .associatorNames = not_offered,
    .references = not_offered,
    .referenceNames = not_offered,
    .invokeMethod = not_offered,
    .setProperty = not_offered,
    .getProperty = not_offered,
};

} // namespace cimserver
