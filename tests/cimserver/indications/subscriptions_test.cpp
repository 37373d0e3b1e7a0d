// The calls that a module sees while subscriptions come and go, in both servers' orders, and what is stored.
#include "cimserver/indications/subscriptions.h"

#include "alert_module.h"
#include "cimserver/broker/request.h"
#include "cimserver/model/names.h"

#include <gtest/gtest.h>

#include <dlfcn.h>
#include <filesystem>

using namespace cimserver;
using Kind = Subscription_Kind;
using Calls = std::vector<std::string>;

namespace
{

const std::string query = "SELECT * FROM TST_Event";
const std::string by_class = query + " TST_Event|root/zemlar:TST_Alert";
const std::string nameless = query + " |root/zemlar:";

Value text(const std::string& value) { return {CMPI_string, value}; }

Instance filter(const std::string& name, const std::string& its_query = query, const std::string& language = "WQL")
{
    return {{"", "", "CIM_IndicationFilter", {{"Name", text(name)}}},
            {{"Query", text(its_query)}, {"QueryLanguage", text(language)}}};
}

Instance destination(const std::string& name, const std::string& url = "http://127.0.0.1:1/")
{
    return {{"", "", "CIM_ListenerDestinationCIMXML", {{"Name", text(name)}}}, {{"Destination", text(url)}}};
}

Instance subscription(const Object_Path& its_filter, const Object_Path& handler)
{
    const auto reference = [](const Object_Path& path) { return Value{CMPI_ref, path}; };
    return {{"", "", "CIM_IndicationSubscription", {{"Filter", reference(its_filter)}, {"Handler", reference(handler)}}}, {}};
}

class subscriptions : public testing::Test
{
protected:
    std::string folder = testing::TempDir() + "subscriptions-" + std::to_string(getpid());
    Module module{ALERT_MODULE};
    test::Recorded_Calls& recorded = *reinterpret_cast<test::Recorded_Calls* (*)()>(dlsym(RTLD_DEFAULT, "recorded_calls"))();
    Delivery delivery{Delivery_Limits{}};
    std::unique_ptr<Subscription_Store> store;
    std::unique_ptr<Subscriptions> under_test;

    void SetUp() override { recorded = {}; }
    void TearDown() override { std::filesystem::remove_all(folder); }

    void start(Indication_Order order)
    {
        under_test.reset();
        store.reset();
        store = std::make_unique<Subscription_Store>(folder);
        under_test = std::make_unique<Subscriptions>(module, delivery, order, store.get());
        under_test->restore();
    }

    Object_Path create(Kind kind, const Instance& instance) { return under_test->create(kind, instance); }

    Object_Path subscribe(const std::string& name)
    {
        const Principal_Scope user("alice");
        const Object_Path its_filter = create(Kind::filter, filter(name));
        return create(Kind::subscription, subscription(its_filter, create(Kind::destination, destination(name))));
    }

    // The CIM status of a refusal, 0 without one.
    int refusal(Kind kind, const Instance& instance)
    {
        try
        {
            under_test->create(kind, instance);
            return 0;
        }
        catch (const Cim_Error& error)
        {
            return error.code();
        }
    }

    Calls calls() { return std::exchange(recorded.calls, {}); }
};

} // namespace

TEST_F(subscriptions, are_told_to_the_module_in_the_order_of_sfcb)
{
    start(Indication_Order::sfcb);
    const Object_Path first = subscribe("a");
    EXPECT_EQ(calls(),
              Calls({"authorize " + by_class + " alice", "poll " + by_class, "activate " + by_class + " first", "enable"}));
    const Object_Path second = subscribe("b");
    EXPECT_EQ(calls(), Calls({"authorize " + by_class + " alice", "poll " + by_class, "activate " + by_class}));
    under_test->remove(Kind::subscription, first);
    EXPECT_EQ(calls(), Calls({"deactivate " + nameless}));
    under_test->remove(Kind::subscription, second);
    EXPECT_EQ(calls(), Calls({"disable", "deactivate " + nameless + " last"}));
}

TEST_F(subscriptions, are_told_to_the_module_in_the_order_of_open_pegasus)
{
    start(Indication_Order::open_pegasus);
    const Object_Path first = subscribe("a");
    EXPECT_EQ(calls(), Calls({"activate " + by_class + " first", "enable"}));
    const Object_Path second = subscribe("b");
    EXPECT_EQ(calls(), Calls({"activate " + by_class}));

    start(Indication_Order::open_pegasus); // a restart
    EXPECT_EQ(calls(), Calls({"activate " + by_class + " first", "activate " + by_class, "enable"}));

    under_test->remove(Kind::subscription, first);
    under_test->remove(Kind::subscription, second);
    EXPECT_EQ(calls(), Calls({"deactivate " + by_class, "deactivate " + by_class + " last", "disable"}));

    subscribe("c");
    calls();
    under_test->stop();
    EXPECT_EQ(calls(), Calls({"deactivate " + by_class + " last", "disable"}));
    EXPECT_EQ(under_test->list(Kind::subscription).size(), 1U) << "a stop deletes nothing";
}

TEST_F(subscriptions, leave_nothing_behind_when_the_module_refuses)
{
    start(Indication_Order::sfcb);
    const Object_Path its_filter = create(Kind::filter, filter("a"));
    const Instance wanted = subscription(its_filter, create(Kind::destination, destination("a")));
    const std::pair<const char*, Calls> rows[] = {
        {"authorize", {"authorize " + by_class + " root"}},
        {"activate", {"authorize " + by_class + " root", "poll " + by_class, "activate " + by_class + " first"}},
        {"enable",
         {"authorize " + by_class + " root", "poll " + by_class, "activate " + by_class + " first", "enable",
          "deactivate " + nameless + " last"}},
    };
    for (const auto& [failing, seen] : rows)
    {
        recorded.failing = failing;
        EXPECT_EQ(refusal(Kind::subscription, wanted), CIM_ERR_FAILED) << failing;
        EXPECT_EQ(calls(), seen);
        EXPECT_TRUE(under_test->list(Kind::subscription).empty());
    }
    recorded.failing = "poll"; // the answer does not count
    EXPECT_EQ(refusal(Kind::subscription, wanted), 0);

    recorded.failing = "enable"; // at a restart it stays off, until somebody subscribes again
    start(Indication_Order::open_pegasus);
    EXPECT_EQ(under_test->list(Kind::subscription).size(), 1U);
    recorded = {};
    subscribe("b");
    EXPECT_EQ(calls(), Calls({"activate " + by_class, "enable"}));
}
