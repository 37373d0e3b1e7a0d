// The life of an adapter: made by the first factory call, shared by all interfaces, gone with the last cleanup.
#include "cmpi/thread_context.h"
#include "tests/cmpi/served_provider.h"

#include <gmock/gmock.h>

#include <atomic>
#include <stdexcept>
#include <thread>

using namespace test;
using testing::Each;
using testing::ElementsAre;

namespace
{

class Life : public Served_Provider
{
protected:
    template <class MI> CMPIrc clean_up(MI* mi, bool terminating = false)
    {
        return mi->ft->cleanup(mi, request.context(), terminating).rc;
    }

    // One interface of each kind, all of one provider.
    struct Kinds
    {
        CMPIInstanceMI* instances;
        CMPIMethodMI* methods;
        CMPIAssociationMI* associations;
        CMPIIndicationMI* indications;
    };
    Kinds all_kinds()
    {
        return {links(), interface<CMPIMethodMI>('M', link_data, link_registration), associations(),
                interface<CMPIIndicationMI>('N', link_data, link_registration)};
    }
    std::vector<CMPIrc> clean_up_all(const Kinds& kinds, bool terminating)
    {
        return {clean_up(kinds.instances, terminating), clean_up(kinds.methods, terminating),
                clean_up(kinds.associations, terminating), clean_up(kinds.indications, terminating)};
    }
};

TEST_F(Life, all_interfaces_share_one_adapter_and_one_loaded_provider)
{
    const auto [instances, methods, associations, indications] = all_kinds();
    ASSERT_TRUE(link_data.adapter);
    EXPECT_EQ(link_data.adapter->load_count, 4U);
    EXPECT_EQ(link_data.adapter->mc, &TST_Pair::static_meta_class);
    EXPECT_EQ(script.loads, 1);
    EXPECT_EQ(script.providers, 1);
    for (void* hdl : {instances->hdl, methods->hdl, associations->hdl, indications->hdl})
        EXPECT_EQ(hdl, &link_data);
    EXPECT_EQ(interface<void>('P', link_data, link_registration), nullptr) << "no such kind";

    const std::string long_name(300, 'x');
    Registration registration = thing_registration;
    registration.provider_name = long_name.c_str();
    EXPECT_EQ(interface<CMPIInstanceMI>('I', thing_data, registration)->ft->miName, "instance" + std::string(247, 'x'));
}

TEST_F(Life, the_last_cleanup_unloads_and_the_next_factory_call_begins_afresh)
{
    for (int round = 1; round <= 2; ++round)
    {
        auto* instances = things();
        auto* methods = interface<CMPIMethodMI>('M', thing_data, thing_registration);
        EXPECT_EQ(script.loads, round);

        EXPECT_EQ(clean_up(methods), CMPI_RC_OK);
        EXPECT_EQ(script.unloads, round - 1);
        EXPECT_EQ(thing_data.adapter->load_count, 1U);

        EXPECT_EQ(clean_up(instances), CMPI_RC_OK);
        EXPECT_EQ(script.unloads, round);
        EXPECT_EQ(script.providers, 0);
        EXPECT_EQ(thing_data.adapter, nullptr);
        EXPECT_EQ(thing_data.magic, 0xDDDDDDDD);
    }
}

TEST_F(Life, an_adapter_that_may_not_unload_stays_until_the_server_ends)
{
    const Kinds kinds = all_kinds();
    link_data.adapter->allow_unload = false;
    EXPECT_THAT(clean_up_all(kinds, false), Each(CMPI_RC_DO_NOT_UNLOAD));
    EXPECT_EQ(link_data.adapter->load_count, 4U);
    EXPECT_EQ(script.unloads, 0);
    EXPECT_THAT(clean_up_all(kinds, true), Each(CMPI_RC_OK));
    EXPECT_EQ(script.unloads, 1);
}

TEST_F(Life, every_entry_and_exit_is_traced)
{
    const std::string factory = "cimple_cmpi_adapter";
    const auto kinds = all_kinds();
    const auto* filter_path = path("TST_Alert");
    const CMPIContext* context = request.context();
    const std::pair<std::string, std::function<void()>> rows[] = {
        {factory, [&] { links(); }},
        {"execQuery", [&] { CMPI_Adapter::execQuery(kinds.instances, context, nullptr, nullptr, "", ""); }},
        {"authorizeFilter", [&] { CMPI_Adapter::authorizeFilter(kinds.indications, nullptr, nullptr, "", filter_path, ""); }},
        {"mustPoll", [&] { CMPI_Adapter::mustPoll(kinds.indications, nullptr, nullptr, "", filter_path); }},
        {"instanceCleanup", [&] { clean_up(kinds.instances); }},
        {"methodCleanup", [&] { clean_up(kinds.methods); }},
        {"associationCleanup", [&] { clean_up(kinds.associations); }},
        {"indicationCleanup", [&] { clean_up(kinds.indications); }},
    };
    for (const auto& [name, work] : rows)
    {
        const std::string code = name == factory ? "" : name == "execQuery" ? ": CMPI_RC_ERR_NOT_SUPPORTED" : ": CMPI_RC_OK";
        EXPECT_THAT(logged(work, "DBG"),
                    ElementsAre("CMPI_Adapter: enter: " + name + "()", "CMPI_Adapter: return: " + name + "()" + code));
    }
}

TEST_F(Life, a_provider_loads_and_unloads_in_a_thread_context_of_its_server)
{
    std::vector<bool> unloaded_in_context;
    script.on_load = [&]
    {
        const auto* seen = dynamic_cast<CMPI_Thread_Context*>(Thread_Context::top());
        ASSERT_TRUE(seen);
        EXPECT_EQ(seen->cmpi_broker(), broker.face());
        EXPECT_EQ(seen->cmpi_context(), request.context());
    };
    script.on_unload = [&] { unloaded_in_context.push_back(Thread_Context::top() != nullptr); };
    clean_up(links());
    clean_up(interface<CMPIMethodMI>('M', link_data, link_registration));
    clean_up(associations());
    clean_up(interface<CMPIIndicationMI>('N', link_data, link_registration));
    EXPECT_EQ(script.loads, 4);
    EXPECT_THAT(unloaded_in_context, ElementsAre(true, true, false, true)) << "associations go without one";
    EXPECT_EQ(Thread_Context::top(), nullptr);
}

TEST_F(Life, exceptions_of_a_provider_reach_nobody)
{
    script.on_load = [] { throw std::runtime_error("load"); };
    EXPECT_EQ(things(), nullptr);
    EXPECT_EQ(thing_data.adapter, nullptr);
    EXPECT_EQ(script.providers, 0);
    EXPECT_EQ(Thread_Context::top(), nullptr);

    script.on_load = nullptr;
    script.on_unload = [] { throw 1; };
    EXPECT_EQ(clean_up(things()), CMPI_RC_OK);
    EXPECT_EQ(script.providers, 0);
}

TEST_F(Life, a_cleanup_waits_for_the_requests_that_run_and_refuses_new_ones)
{
    auto* mi = things();
    std::atomic<bool> entered = false, cleaning = false, answered = false;
    script.on_enum = [&]
    {
        entered = true;
        while (!cleaning || !thing_data.adapter->requests.is_shut())
            std::this_thread::yield();
        cimserver::Request own;
        Recorded_Result refused;
        EXPECT_EQ(CMPI_Adapter::enumInstances(mi, own.context(), refused.face(), path("TST_Thing"), nullptr).rc,
                  CMPI_RC_ERR_FAILED);
        EXPECT_EQ(things(), nullptr) << "an interface of a provider that waits for this very request";
    };
    std::thread client(
        [&]
        {
            cimserver::Request own;
            Recorded_Result result;
            EXPECT_EQ(CMPI_Adapter::enumInstances(mi, own.context(), result.face(), path("TST_Thing"), nullptr).rc, CMPI_RC_OK);
            answered = true;
        });
    while (!entered)
        std::this_thread::yield();
    cleaning = true;
    EXPECT_EQ(clean_up(mi), CMPI_RC_OK);
    client.join();
    EXPECT_TRUE(answered);
    EXPECT_EQ(script.providers, 0);
}

using Life_Death_Test = Life;

TEST_F(Life_Death_Test, a_broken_interface_is_an_internal_error)
{
    auto* mi = things();
    const auto call = [&](CMPIInstanceMI* broken)
    { CMPI_Adapter::execQuery(broken, request.context(), nullptr, nullptr, "", ""); };
    CMPIInstanceMI empty = {nullptr, nullptr};
    EXPECT_DEATH(call(nullptr), "assert: mi != 0\n\n");
    EXPECT_DEATH(call(&empty), "assert: sd != 0\n\n");
    EXPECT_DEATH(CMPI_Adapter::execQuery(mi, nullptr, nullptr, nullptr, "", ""), "assert: cmpi_context\n\n");

    CMPI_Adapter* adapter = thing_data.adapter;
    EXPECT_DEATH((thing_data.adapter = nullptr, call(mi)), "assert: sd->adapter\n\n");
    EXPECT_DEATH((thing_data.adapter = nullptr, delete adapter), "assert: sd->adapter == this\n\n");
    EXPECT_DEATH((thing_data.magic = 0, call(mi)), "assert: sd->magic == STATIC_DATA_MAGIC\n\n");
    EXPECT_DEATH((thing_data.magic = 0, delete adapter), "assert: sd->magic == STATIC_DATA_MAGIC\n\n");
    EXPECT_DEATH((adapter->magic.~Magic(), call(mi)), "assert: sd->adapter->magic\n\n");
}

} // namespace
