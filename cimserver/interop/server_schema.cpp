#include "cimserver/interop/server_schema.h"

#include "runtime/types.h"

#include <cstddef>
#include <iterator>

namespace cimserver
{
namespace
{

using namespace zmlr;

extern const Meta_Repository repository;

constexpr Meta_Property property(const char* name, Type type, uint32 flags = 0, sint16 subscript = 0,
                                 const Meta_Value* value = nullptr)
{
    return {
        {{0}, Flag_Property | Flag_Read | flags, name, nullptr, 0}, static_cast<uint16>(type), subscript, 0, value,
    };
}

constexpr Meta_Property key(const char* name) { return property(name, STRING, Flag_Key | Flag_Required); }

constexpr Meta_Reference key_reference(const char* name, const Meta_Class* target)
{
    return {{{0}, Flag_Reference | Flag_Read | Flag_Key, name, nullptr, 0}, 0, target, 0};
}

// The marks of a class whose first `inherited` features come from its superclass.
template <std::size_t N> struct Locals
{
    explicit constexpr Locals(std::size_t inherited)
    {
        for (std::size_t i = 0; i < N; ++i)
            marks[i].local = i < inherited ? 0 : 1;
    }
    Meta_Feature_Local marks[N] = {};
};

template <std::size_t N>
constexpr Meta_Class make_class(const char* name, uint32 flags, const Meta_Feature* const (&features)[N], const Locals<N>& locals,
                                const Meta_Class* super, uint32 num_keys)
{
    return {{{{0}, Flag_Class | flags, name, nullptr, 0}, features, N, 0}, locals.marks, super, num_keys, &repository};
}

constexpr bool yes = true;
constexpr Meta_Value true_default{&yes, 1};

// CIM_ManagedElement
constexpr Meta_Property instance_id = property("InstanceID", STRING);
constexpr Meta_Property caption = property("Caption", STRING);
constexpr Meta_Property description = property("Description", STRING);
constexpr Meta_Property element_name = property("ElementName", STRING);

// What names most objects: the system they are on, their class, a name.
constexpr Meta_Property system_class = key("SystemCreationClassName");
constexpr Meta_Property system_name = key("SystemName");
constexpr Meta_Property creation_class = key("CreationClassName");
constexpr Meta_Property name = key("Name");

// CIM_ObjectManager
constexpr Meta_Property operational_status = property("OperationalStatus", UINT16, 0, -1);
constexpr Meta_Property started = property("Started", BOOLEAN);
constexpr Meta_Property gather_statistics = property("GatherStatisticalData", BOOLEAN);

// CIM_Namespace
constexpr Meta_Property manager_class = key("ObjectManagerCreationClassName");
constexpr Meta_Property manager_name = key("ObjectManagerName");
constexpr Meta_Property class_info = property("ClassInfo", UINT16, Flag_Required);
constexpr Meta_Property class_type = property("ClassType", UINT16);

// CIM_IndicationFilter
constexpr Meta_Property individual_subscription = property("IndividualSubscriptionSupported", BOOLEAN, 0, 0, &true_default);
constexpr Meta_Property source_name_space = property("SourceNamespace", STRING, Flag_Write);
constexpr Meta_Property source_name_spaces = property("SourceNamespaces", STRING, Flag_Write, -1);
constexpr Meta_Property query = property("Query", STRING, Flag_Required | Flag_Write);
constexpr Meta_Property query_language = property("QueryLanguage", STRING, Flag_Required | Flag_Write);

// CIM_ListenerDestination
constexpr Meta_Property persistence_type = property("PersistenceType", UINT16, Flag_Write);
constexpr Meta_Property other_persistence_type = property("OtherPersistenceType", STRING, Flag_Write);
constexpr Meta_Property destination = property("Destination", STRING, Flag_Write);
constexpr Meta_Property protocol = property("Protocol", UINT16, Flag_Write);
constexpr Meta_Property other_protocol = property("OtherProtocol", STRING, Flag_Write);
constexpr Meta_Property required_destination = property("Destination", STRING, Flag_Required | Flag_Write);

// CIM_IndicationSubscription
constexpr Meta_Reference filter = key_reference("Filter", &CIM_IndicationFilter);
constexpr Meta_Reference handler = key_reference("Handler", &CIM_ListenerDestination);
constexpr Meta_Property subscription[] = {
    property("OnFatalErrorPolicy", UINT16, Flag_Write),
    property("OtherOnFatalErrorPolicy", STRING, Flag_Write),
    property("FailureTriggerTimeInterval", UINT64, Flag_Write),
    property("SubscriptionState", UINT16, Flag_Write),
    property("OtherSubscriptionState", STRING, Flag_Write),
    property("TimeOfLastStateChange", DATETIME),
    property("SubscriptionDuration", UINT64, Flag_Write),
    property("SubscriptionStartTime", DATETIME),
    property("SubscriptionTimeRemaining", UINT64),
    property("RepeatNotificationPolicy", UINT16, Flag_Write),
    property("OtherRepeatNotificationPolicy", STRING, Flag_Write),
    property("RepeatNotificationInterval", UINT64, Flag_Write),
    property("RepeatNotificationGap", UINT64, Flag_Write),
    property("RepeatNotificationCount", UINT16, Flag_Write),
};

constexpr const Meta_Feature* element_features[] = {&instance_id, &caption, &description, &element_name};
constexpr std::size_t element_size = std::size(element_features);

constexpr const Meta_Feature* manager_features[] = {
    &instance_id,    &caption, &description,        &element_name, &system_class,      &system_name,
    &creation_class, &name,    &operational_status, &started,      &gather_statistics,
};

constexpr const Meta_Feature* name_space_features[] = {
    &instance_id,   &caption,      &description,    &element_name, &system_class, &system_name,
    &manager_class, &manager_name, &creation_class, &name,         &class_info,   &class_type,
};

constexpr const Meta_Feature* filter_features[] = {
    &instance_id,
    &caption,
    &description,
    &element_name,
    &system_class,
    &system_name,
    &creation_class,
    &name,
    &individual_subscription,
    &source_name_space,
    &source_name_spaces,
    &query,
    &query_language,
};

constexpr const Meta_Feature* destination_features[] = {
    &instance_id, &caption,        &description,    &element_name,     &system_class,
    &system_name, &creation_class, &name,           &persistence_type, &other_persistence_type,
    &destination, &protocol,       &other_protocol,
};

constexpr const Meta_Feature* cimxml_destination_features[] = {
    &instance_id,          &caption,        &description,    &element_name,     &system_class,
    &system_name,          &creation_class, &name,           &persistence_type, &other_persistence_type,
    &required_destination, &protocol,       &other_protocol,
};

constexpr const Meta_Feature* subscription_features[] = {
    &filter,           &handler,          &subscription[0],  &subscription[1],  &subscription[2], &subscription[3],
    &subscription[4],  &subscription[5],  &subscription[6],  &subscription[7],  &subscription[8], &subscription[9],
    &subscription[10], &subscription[11], &subscription[12], &subscription[13],
};

constexpr Locals<element_size> element_locals(0);
constexpr Locals<std::size(manager_features)> manager_locals(element_size);
constexpr Locals<std::size(name_space_features)> name_space_locals(element_size);
constexpr Locals<std::size(filter_features)> filter_locals(element_size);
constexpr Locals<std::size(destination_features)> destination_locals(element_size);
constexpr Locals<std::size(subscription_features)> subscription_locals(0);

// It overrides one feature and declares none.
constexpr Locals<std::size(cimxml_destination_features)> make_cimxml_locals()
{
    Locals<std::size(cimxml_destination_features)> locals(std::size(cimxml_destination_features));
    for (std::size_t i = 0; i < std::size(cimxml_destination_features); ++i)
        locals.marks[i].local = cimxml_destination_features[i] == &required_destination;
    return locals;
}
constexpr auto cimxml_destination_locals = make_cimxml_locals();

} // namespace

// clang-format off
constinit const Meta_Class CIM_ManagedElement =
    make_class("CIM_ManagedElement", Flag_Abstract, element_features, element_locals, nullptr, 0);
constinit const Meta_Class CIM_ObjectManager =
    make_class("CIM_ObjectManager", 0, manager_features, manager_locals, &CIM_ManagedElement, 4);
constinit const Meta_Class CIM_Namespace =
    make_class("CIM_Namespace", 0, name_space_features, name_space_locals, &CIM_ManagedElement, 6);
constinit const Meta_Class CIM_IndicationFilter =
    make_class("CIM_IndicationFilter", 0, filter_features, filter_locals, &CIM_ManagedElement, 4);
constinit const Meta_Class CIM_ListenerDestination =
    make_class("CIM_ListenerDestination", 0, destination_features, destination_locals, &CIM_ManagedElement, 4);
constinit const Meta_Class CIM_ListenerDestinationCIMXML =
    make_class("CIM_ListenerDestinationCIMXML", 0, cimxml_destination_features, cimxml_destination_locals,
               &CIM_ListenerDestination, 4);
constinit const Meta_Class CIM_IndicationSubscription =
    make_class("CIM_IndicationSubscription", Flag_Association, subscription_features, subscription_locals, nullptr, 2);
// clang-format on

namespace
{

constexpr const Meta_Class* classes[] = {
    &CIM_ManagedElement,         &CIM_ObjectManager,       &CIM_Namespace,
    &CIM_IndicationFilter,       &CIM_ListenerDestination, &CIM_ListenerDestinationCIMXML,
    &CIM_IndicationSubscription,
};
constinit const Meta_Repository repository = {classes, std::size(classes)};

constexpr Registration registration(const Meta_Class* meta_class, const char* class_name, const Registration* next)
{
    return {"zmlr-cimserver", class_name, nullptr, meta_class, next};
}

constexpr Registration registered[6] = {
    registration(&CIM_ObjectManager, "CIM_ObjectManager", nullptr),
    registration(&CIM_Namespace, "CIM_Namespace", &registered[0]),
    registration(&CIM_IndicationFilter, "CIM_IndicationFilter", &registered[1]),
    registration(&CIM_ListenerDestination, "CIM_ListenerDestination", &registered[2]),
    registration(&CIM_ListenerDestinationCIMXML, "CIM_ListenerDestinationCIMXML", &registered[3]),
    registration(&CIM_IndicationSubscription, "CIM_IndicationSubscription", &registered[4]),
};

} // namespace

const Registration* server_registrations() { return &registered[std::size(registered) - 1]; }

} // namespace cimserver
