#include "cimserver/indications/subscription_rules.h"

#include "cimserver/indications/delivery.h"
#include "cimserver/model/names.h"
#include "cimserver/model/server_identity.h"
#include "cimserver/operations/module_operations.h"

#include <algorithm>
#include <cstdio>
#include <ctime>

namespace cimserver
{
namespace
{

constexpr std::size_t max_name_bytes = 1024;
constexpr std::size_t max_instance_bytes = 8192; // all texts together
constexpr std::uint64_t permanent = 2;           // PersistenceType
constexpr std::uint64_t cim_xml = 2;             // Protocol
constexpr std::uint64_t enabled = 2;             // SubscriptionState
constexpr std::uint64_t ignored = 2;             // OnFatalErrorPolicy
constexpr std::uint64_t not_suppressed = 2;      // RepeatNotificationPolicy

[[noreturn]] void refuse(const Instance& instance, const std::string& why, int code = CIM_ERR_INVALID_PARAMETER)
{
    throw Cim_Error(code, instance.path.class_name.string() + ": " + why);
}

const Value* value_of(const Instance& instance, std::string_view name)
{
    const Value* property = instance.properties.find(name);
    return property && !property->null() ? property : nullptr;
}

std::string text_of(const Instance& instance, std::string_view name)
{
    const Value* property = instance.properties.find(name);
    const auto* text = property ? property->as<Text>() : nullptr;
    return text ? *text : "";
}

std::size_t text_bytes(const Value& value)
{
    if (const auto* text = value.as<Text>())
        return text->view().size();
    std::size_t bytes = 0;
    if (const auto* elements = value.as<std::vector<Value>>())
        for (const Value& element : *elements)
            bytes += 1 + text_bytes(element);
    return bytes;
}

void check_size(const Instance& instance)
{
    std::size_t bytes = 0;
    for (const auto& property : instance.properties)
        bytes += text_bytes(property.value);
    if (bytes > max_instance_bytes)
        refuse(instance, "its texts are longer than " + std::to_string(max_instance_bytes) + " bytes");
}

// Adds a number that the client did not give.
void complete(Instance& instance, const std::string& name, std::uint64_t value)
{
    if (!value_of(instance, name))
        instance.properties.put(name, {CMPI_uint16, value});
}

// The four keys that filters and destinations have.
void complete_keys(Instance& instance)
{
    check_size(instance);
    const std::pair<const char*, std::string> keys[] = {
        {"SystemCreationClassName", "CIM_ComputerSystem"},
        {"SystemName", host_name()},
        {"CreationClassName", instance.path.class_name},
        {"Name", ""},
    };
    std::vector<Named_Value> complete;
    for (const auto& [name, otherwise] : keys)
    {
        const Named_Value* given = find_named(instance.path.keys, name);
        const auto* text = given ? given->value.as<Text>() : nullptr;
        const std::string value = text ? text->string() : otherwise;
        if (value.empty() || value.size() > max_name_bytes)
            refuse(instance, std::string(name) + " has 1 to " + std::to_string(max_name_bytes) + " bytes");
        complete.push_back({name, {CMPI_string, value}});
        instance.properties.put(name, {CMPI_string, value});
    }
    if (!equal_names(text_of(instance, "CreationClassName"), instance.path.class_name))
        refuse(instance, "CreationClassName is another class");
    instance.path.keys = std::move(complete);
}

// Refuses any value but the one that the server keeps to.
void allow_only(Instance& instance, const std::string& name, std::uint64_t value)
{
    const Value* given = value_of(instance, name);
    const auto* number = given ? given->as<std::uint64_t>() : nullptr;
    if (given && (!number || *number != value))
        refuse(instance, name + " can only be " + std::to_string(value), CIM_ERR_NOT_SUPPORTED);
    complete(instance, name, value);
}

std::vector<std::string> source_name_spaces(const Instance& filter)
{
    std::vector<std::string> names;
    if (const std::string one = text_of(filter, "SourceNamespace"); !one.empty())
        names.push_back(one);
    const Value* several = filter.properties.find("SourceNamespaces");
    if (const auto* list = several ? several->as<std::vector<Value>>() : nullptr)
        for (const Value& element : *list)
            if (const auto* text = element.as<Text>())
                names.push_back(*text);
    return names;
}

std::string now_text()
{
    std::timespec now{};
    std::timespec_get(&now, TIME_UTC);
    std::tm fields{};
    gmtime_r(&now.tv_sec, &fields);
    char text[32] = "";
    const std::size_t size = std::strftime(text, sizeof text, "%Y%m%d%H%M%S", &fields);
    std::snprintf(text + size, sizeof text - size, ".%06ld+000", now.tv_nsec / 1000);
    return text;
}

} // namespace

Instance complete_filter(Instance instance)
{
    complete_keys(instance);
    const std::string language = text_of(instance, "QueryLanguage");
    if (language.empty() || text_of(instance, "Query").empty())
        refuse(instance, "it needs a Query and a QueryLanguage");
    if (!equal_names(language, "WQL") && !equal_names(language, "DMTF:CQL"))
        refuse(instance, "the query languages are WQL and DMTF:CQL", CIM_ERR_QUERY_LANGUAGE_NOT_SUPPORTED);
    return instance;
}

Event_Filter event_filter(const Instance& filter, const Repository& repository)
{
    for (const std::string& name : source_name_spaces(filter))
        if (!equal_names(name, Module_Operations::served_name_space))
            refuse(filter, "name space " + name + " raises no indications");

    Event_Query query(text_of(filter, "Query"));
    const Class_Entry* entry = repository.find(query.class_name());
    if (!entry || (entry->meta_class->flags & zmlr::Flag_Indication) == 0)
        refuse(filter, "there is no indication class " + query.class_name(), CIM_ERR_INVALID_QUERY);
    query.check(*entry->layout);
    return {std::move(query), entry};
}

Instance complete_destination(Instance instance)
{
    complete_keys(instance);
    if (!is_listener_url(text_of(instance, "Destination")))
        refuse(instance, "Destination must be the URL of a listener: http or https, a host, no user name");
    allow_only(instance, "Protocol", cim_xml);
    complete(instance, "PersistenceType", permanent);
    return instance;
}

Instance complete_subscription(Instance instance)
{
    check_size(instance);
    for (const char* end : {"Filter", "Handler"})
    {
        const Named_Value* key = find_named(instance.path.keys, end);
        if (!key || key->value.null())
            refuse(instance, std::string("it needs a ") + end);
        instance.properties.put(end, key->value);
    }
    if (value_of(instance, "SubscriptionDuration"))
        refuse(instance, "it lasts until it is deleted: a SubscriptionDuration is not kept", CIM_ERR_NOT_SUPPORTED);
    allow_only(instance, "OnFatalErrorPolicy", ignored);
    allow_only(instance, "RepeatNotificationPolicy", not_suppressed);
    allow_only(instance, "SubscriptionState", enabled);
    if (!value_of(instance, "SubscriptionStartTime"))
        instance.properties.put("SubscriptionStartTime", {CMPI_dateTime, now_text()});
    return instance;
}

} // namespace cimserver
