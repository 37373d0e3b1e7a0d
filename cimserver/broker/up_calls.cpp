// The broker's own table: attaching threads, and requests that a provider sends back through the server.
#include "cimserver/broker/broker.h"
#include "cimserver/broker/conversion.h"
#include "cimserver/broker/objects.h"
#include "cimserver/broker/return_code.h"
#include "cimserver/operations.h"

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

// An up-call that answers several objects of a CMPI type.
template <class Body>
CMPIEnumeration* enumerate(const CMPIBroker* broker, const CMPIContext* context, CMPIType type, CMPIStatus* status,
                           Body body) noexcept
{
    return answer<CMPIEnumeration*>(status, nullptr, [&] { return enumeration(type, up_call(broker, context, body)); });
}

CMPIEnumeration* enumerate_instance_names(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* self,
                                          CMPIStatus* status) noexcept
{
    const auto body = [&](Operations& operations)
    {
        const Object_Path& path = object<Path_Object>(self).path;
        return operations.enumerate_instance_names(path.name_space, path.class_name);
    };
    return enumerate(broker, context, CMPI_ref, status, body);
}

CMPIEnumeration* enumerate_instances(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* self,
                                     const char** properties, CMPIStatus* status) noexcept
{
    const auto body = [&](Operations& operations)
    {
        const Object_Path& path = object<Path_Object>(self).path;
        return operations.enumerate_instances(path.name_space, path.class_name, true, property_list(properties));
    };
    return enumerate(broker, context, CMPI_instance, status, body);
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

// An instance under a path of its own, as the server's operations take it.
Instance at(const CMPIObjectPath* path, const CMPIInstance* instance)
{
    Instance result = object<Instance_Object>(instance).model();
    result.path = object<Path_Object>(path).path;
    return result;
}

CMPIObjectPath* create_instance(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                                const CMPIInstance* instance, CMPIStatus* status) noexcept
{
    const auto body = [&]
    {
        const Instance source = at(path, instance);
        return make<Path_Object>(
                   up_call(broker, context, [&](Operations& operations) { return operations.create_instance(source); }))
            .face();
    };
    return answer<CMPIObjectPath*>(status, nullptr, body);
}

CMPIStatus modify_instance(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                           const CMPIInstance* instance, const char** properties) noexcept
{
    return answer(
        [&]
        {
            const Instance source = at(path, instance);
            up_call(broker, context,
                    [&](Operations& operations) { operations.modify_instance(source, property_list(properties)); });
        });
}

CMPIStatus delete_instance(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path) noexcept
{
    return answer(
        [&] {
            up_call(broker, context, [&](Operations& operations) { operations.delete_instance(object<Path_Object>(path).path); });
        });
}

CMPIEnumeration* exec_query(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path, const char* query,
                            const char* language, CMPIStatus* status) noexcept
{
    const auto body = [&](Operations& operations)
    { return operations.exec_query(object<Path_Object>(path).path.name_space, required(query), required(language)); };
    return enumerate(broker, context, CMPI_instance, status, body);
}

std::string optional(const char* text) { return text ? text : ""; }

CMPIEnumeration* associators(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                             const char* association_class, const char* result_class, const char* role, const char* result_role,
                             const char** properties, CMPIStatus* status) noexcept
{
    const auto body = [&](Operations& operations)
    {
        return operations.associators(
            object<Path_Object>(path).path,
            {optional(association_class), optional(result_class), optional(role), optional(result_role)},
            property_list(properties));
    };
    return enumerate(broker, context, CMPI_instance, status, body);
}

CMPIEnumeration* associator_names(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                                  const char* association_class, const char* result_class, const char* role,
                                  const char* result_role, CMPIStatus* status) noexcept
{
    const auto body = [&](Operations& operations)
    {
        return operations.associator_names(object<Path_Object>(path).path, {optional(association_class), optional(result_class),
                                                                            optional(role), optional(result_role)});
    };
    return enumerate(broker, context, CMPI_ref, status, body);
}

CMPIEnumeration* references(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                            const char* result_class, const char* role, const char** properties, CMPIStatus* status) noexcept
{
    const auto body = [&](Operations& operations)
    {
        return operations.references(object<Path_Object>(path).path, {optional(result_class), "", optional(role), ""},
                                     property_list(properties));
    };
    return enumerate(broker, context, CMPI_instance, status, body);
}

CMPIEnumeration* reference_names(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                                 const char* result_class, const char* role, CMPIStatus* status) noexcept
{
    const auto body = [&](Operations& operations) {
        return operations.reference_names(object<Path_Object>(path).path, {optional(result_class), "", optional(role), ""});
    };
    return enumerate(broker, context, CMPI_ref, status, body);
}

CMPIData invoke_method(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path, const char* method,
                       const CMPIArgs* in, CMPIArgs* out, CMPIStatus* status) noexcept
{
    const auto body = [&]
    {
        const auto call = [&](Operations& operations)
        {
            return operations.invoke_method(object<Path_Object>(path).path, required(method),
                                            in ? object<Args_Object>(in).args : std::vector<Named_Value>());
        };
        Method_Result result = up_call(broker, context, call);
        if (out)
            for (Named_Value& output : result.out)
                put(object<Args_Object>(out).args, output.name.c_str(), std::move(output.value));
        return to_cmpi(result.return_value);
    };
    return answer(status, no_data(), body);
}

CMPIStatus set_property(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path, const char* name,
                        const CMPIValue* value, CMPIType type) noexcept
{
    const auto call = [&](Operations& operations)
    { operations.set_property(object<Path_Object>(path).path, required(name), from_cmpi(value, type)); };
    return answer([&] { up_call(broker, context, call); });
}

CMPIData get_property(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path, const char* name,
                      CMPIStatus* status) noexcept
{
    const auto call = [&](Operations& operations)
    { return operations.get_property(object<Path_Object>(path).path, required(name)); };
    return answer(status, no_data(), [&] { return to_cmpi(up_call(broker, context, call)); });
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
