// The interop name space with the server's own classes: what reaches a Server_Class, and traversal along its associations.
#include "cimserver/interop/interop_operations.h"
#include "cimserver/interop/server_schema.h"
#include "loaded_module.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <stdexcept>

namespace cimserver
{
namespace
{

using ::testing::ElementsAre;
using ::testing::IsEmpty;

constexpr const char* interop = Interop_Operations::name_space;

// Keeps the instances that clients make.
class Store : public Server_Class
{
public:
    explicit Store(const zmlr::Meta_Class& meta_class) : _meta_class(meta_class) {}

    const zmlr::Meta_Class& meta_class() const override { return _meta_class; }
    std::vector<Instance> enumerate() override { return instances; }
    Object_Path create(const Instance& instance) override
    {
        instances.push_back(instance);
        return instance.path;
    }
    void modify(const Instance& instance, const std::vector<std::string>& properties) override
    {
        modified = instance;
        modified_properties = properties;
    }
    void remove(const Object_Path& path) override { removed = path; }

    std::vector<Instance> instances;
    Instance modified;
    std::vector<std::string> modified_properties;
    Object_Path removed;

private:
    const zmlr::Meta_Class& _meta_class;
};

class Interop_Test : public Loaded_Module
{
protected:
    Interop_Test()
        : filters(serve(CIM_IndicationFilter))
        , destinations(serve(CIM_ListenerDestinationCIMXML))
        , subscriptions(serve(CIM_IndicationSubscription))
    {
    }

    Store& serve(const zmlr::Meta_Class& meta_class)
    {
        auto store = std::make_unique<Store>(meta_class);
        Store& served = *store;
        operations.interop().serve(std::move(store));
        return served;
    }

    static Object_Path own_path(const std::string& class_name, const std::string& name)
    {
        return {"", interop, class_name, keys(class_name, name)};
    }

    static std::vector<Named_Value> keys(const std::string& class_name, const std::string& name)
    {
        return {{"SystemCreationClassName", text("CIM_ComputerSystem")},
                {"SystemName", text("here")},
                {"CreationClassName", text(class_name)},
                {"Name", text(name)}};
    }

    Object_Path make(const std::string& class_name, const std::string& name)
    {
        return operations.create_instance({{"", interop, class_name, {}}, keys(class_name, name)});
    }

    static Value reference(Object_Path path) { return {CMPI_ref, std::make_shared<const Object_Path>(std::move(path))}; }

    // As a client may name what it subscribes: without a name space.
    Object_Path subscribe(Object_Path filter, Object_Path handler)
    {
        filter.name_space = "";
        handler.name_space = "";
        return operations.create_instance(
            {{"", interop, "CIM_IndicationSubscription", {}}, {{"Filter", reference(filter)}, {"Handler", reference(handler)}}});
    }

    static std::vector<std::string> names_of(const std::vector<Object_Path>& paths)
    {
        std::vector<std::string> names;
        for (const Object_Path& path : paths)
            names.push_back(std::get<std::string>(path.keys.at(3).value.content));
        return names;
    }

    Store& filters;
    Store& destinations;
    Store& subscriptions;
};

TEST_F(Interop_Test, a_class_is_answered_once_and_only_if_the_schema_has_it)
{
    EXPECT_THROW(operations.interop().serve(std::make_unique<Store>(CIM_IndicationFilter)), std::logic_error);
    EXPECT_THROW(operations.interop().serve(std::make_unique<Store>(*operations.get_class("root/zemlar", "TST_Disk"))),
                 std::logic_error);
}

TEST_F(Interop_Test, what_a_client_makes_is_typed_and_shown_whole)
{
    const Object_Path made = operations.create_instance(
        {{"", interop, "cim_listenerdestinationcimxml", {}},
         {{"NAME", text("d")}, {"PersistenceType", text("2")}, {"Destination", text("http://[::1]:1")}}});
    EXPECT_EQ(made.class_name, "CIM_ListenerDestinationCIMXML");
    EXPECT_EQ(made.name_space, interop);
    const Instance& kept = destinations.instances.at(0);
    EXPECT_EQ(find_named(kept.properties, "PersistenceType")->value.type, CMPI_uint16);

    EXPECT_EQ(error_of(
                  [&] {
                      operations.create_instance(
                          {{"", interop, "CIM_ListenerDestinationCIMXML", {}}, {{"PersistenceType", text("-1")}}});
                  }),
              CIM_ERR_INVALID_PARAMETER);
    EXPECT_EQ(error_of(
                  [&] {
                      operations.create_instance({{"", interop, "CIM_ListenerDestination", {}}, {}});
                  }),
              CIM_ERR_NOT_SUPPORTED);
    EXPECT_EQ(destinations.instances.size(), 1U);

    Object_Path path = make("CIM_ListenerDestinationCIMXML", "e");
    path.class_name = "CIM_ListenerDestination";
    const Instance by_superclass = operations.get_instance(path, {});
    EXPECT_EQ(error_of([&] { operations.get_instance(own_path("CIM_ListenerDestination", "f"), {}); }), CIM_ERR_NOT_FOUND);
    EXPECT_EQ(by_superclass.path.class_name, "CIM_ListenerDestinationCIMXML");
    EXPECT_EQ(by_superclass.properties.size(), 13U);
    EXPECT_TRUE(find_named(by_superclass.properties, "Protocol")->value.null());
}

TEST_F(Interop_Test, changes_reach_the_class_with_what_the_client_sent)
{
    const Object_Path path = make("CIM_IndicationFilter", "f");
    operations.modify_instance({path, {{"query", text("select")}}}, std::nullopt);
    EXPECT_THAT(filters.modified_properties, ElementsAre("query"));
    EXPECT_EQ(std::get<std::string>(find_named(filters.modified.properties, "Query")->value.content), "select");
    operations.delete_instance(path);
    EXPECT_EQ(filters.removed.keys.size(), 4U);
    EXPECT_EQ(error_of([&] { operations.delete_instance(own_path("CIM_IndicationFilter", "g")); }), CIM_ERR_NOT_FOUND);
    EXPECT_EQ(error_of(
                  [&] {
                      operations.modify_instance({path, {{"Colour", text("red")}}}, std::nullopt);
                  }),
              CIM_ERR_NO_SUCH_PROPERTY);
}

TEST_F(Interop_Test, subscriptions_lead_from_filters_to_destinations_and_back)
{
    const Object_Path filter = make("CIM_IndicationFilter", "f");
    const Object_Path other = make("CIM_IndicationFilter", "g");
    const Object_Path first = make("CIM_ListenerDestinationCIMXML", "d");
    const Object_Path second = make("CIM_ListenerDestinationCIMXML", "e");
    subscribe(filter, first);
    subscribe(filter, second);
    subscribe(other, second);

    EXPECT_THAT(names_of(operations.associator_names(filter, {})), ElementsAre("d", "e"));
    EXPECT_THAT(names_of(operations.associator_names(second, {})), ElementsAre("f", "g"));
    EXPECT_THAT(names_of(operations.associator_names(second, {"", "CIM_ListenerDestination", "", ""})), IsEmpty());
    EXPECT_THAT(names_of(operations.associator_names(second, {"", "", "handler", ""})), ElementsAre("f", "g"));
    EXPECT_THAT(names_of(operations.associator_names(second, {"", "", "Filter", ""})), IsEmpty());
    EXPECT_THAT(names_of(operations.associator_names(filter, {"", "", "", "Filter"})), IsEmpty());
    EXPECT_EQ(operations.reference_names(second, {}).size(), 2U);
    EXPECT_EQ(operations.reference_names(second, {"CIM_Namespace", "", "", ""}).size(), 0U);
    EXPECT_EQ(operations.references(filter, {}, {{"SubscriptionState"}}).at(0).properties.size(), 1U);
    EXPECT_EQ(operations.associators(filter, {}, {}).at(1).properties.size(), 13U);
    EXPECT_EQ(error_of([&] { operations.associators(filter, {"CIM_Nothing", "", "", ""}, {}); }), CIM_ERR_INVALID_PARAMETER);

    Object_Path local = subscriptions.instances.at(0).path;
    local.name_space = interop;
    EXPECT_EQ(operations.get_instance(local, {}).path.class_name, "CIM_IndicationSubscription");
}

} // namespace
} // namespace cimserver
