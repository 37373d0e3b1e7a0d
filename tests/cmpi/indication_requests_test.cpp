// The indication interface as a server calls it, and the delivery of alerts by provider threads.
#include "cmpi/cimom.h"
#include "cmpi/thread_context.h"
#include "runtime/thread.h"
#include "runtime/time.h"
#include "tests/cmpi/served_provider.h"

#include <cmpimacs.h>
#include <gmock/gmock.h>

#include <atomic>
#include <stdexcept>
#include <thread>

using namespace test;
using testing::ElementsAre;

namespace
{

// What the server was handed, as "name space: message".
class Inbox : public cimserver::Indication_Sink
{
public:
    void deliver(const std::string& name_space, const cimserver::Instance& indication) override
    {
        EXPECT_EQ(indication.path.name_space, name_space) << "one server reads this one, one the other";
        if (++count < 100)
            alerts.push_back(name_space + ": " + indication.properties[1].get<cimserver::Text>().string());
        if (on_delivery)
            on_delivery();
    }

    std::vector<std::string> alerts; // the first ones
    int count = 0;
    std::function<void()> on_delivery;
};

TST_Alert* alert(const char* message)
{
    TST_Alert* result = create<TST_Alert>();
    result->Text.set(message);
    return result;
}

// A thread that the provider starts, and ends on demand.
struct Provider_Thread
{
    void start(std::function<void()> body)
    {
        work = std::move(body);
        const auto run = [](void* self) -> void*
        {
            static_cast<Provider_Thread*>(self)->work();
            return nullptr;
        };
        EXPECT_EQ(Thread::create_joinable(thread, run, this), 0);
    }
    void join()
    {
        void* result = nullptr;
        running = false;
        EXPECT_EQ(Thread::join(thread, result), 0);
    }

    Thread thread;
    std::atomic<bool> running = true;
    std::function<void()> work;
};

class Indications : public Served_Provider
{
protected:
    Indications() { broker.set_indication_sink(&inbox); }

    CMPIObjectPath* filter_path(const char* ns) const { return CMNewObjectPath(broker.face(), ns, "TST_Alert", nullptr); }
    void activate(const char* ns)
    {
        EXPECT_EQ(mi->ft->activateFilter(mi, nullptr, nullptr, "", filter_path(ns), 1).rc, CMPI_RC_OK);
    }
    void deactivate(const char* ns)
    {
        EXPECT_EQ(mi->ft->deActivateFilter(mi, nullptr, nullptr, "", filter_path(ns), 0).rc, CMPI_RC_OK);
    }
    CMPIrc enable() { return mi->ft->enableIndications(mi, request.context()).rc; }
    CMPIrc disable() { return mi->ft->disableIndications(mi, request.context()).rc; }
    CMPIrc clean_up() { return mi->ft->cleanup(mi, request.context(), 0).rc; }

    // Raises an alert in a context that the server made.
    bool raise(const char* message)
    {
        const CMPI_Thread_Context_Pusher pusher(broker.face(), request.context(), alert_data.adapter);
        return script.handler->handle(alert(message));
    }

    // Enables indications; the provider starts the thread meanwhile.
    void enable_with(Provider_Thread& thread, const std::function<void()>& body)
    {
        script.on_enable = [&] { thread.start(body); };
        EXPECT_EQ(enable(), CMPI_RC_OK);
    }
    // The thread raises alerts until it is joined.
    void deliver_from(Provider_Thread& thread)
    {
        const auto body = [&]
        {
            for (; thread.running; ++raised)
                EXPECT_TRUE(script.handler->handle(alert("x")));
        };
        activate("root/a");
        enable_with(thread, body);
    }

    Inbox inbox;
    std::atomic<int> raised = 0;
    CMPIIndicationMI* mi = alerts();
};

TEST_F(Indications, reach_each_name_space_with_a_filter_once)
{
    const struct
    {
        const char* activated;
        const char* deactivated;
        std::vector<std::string> alerts;
    } steps[] = {
        {nullptr, nullptr, {}},
        {"root/b", nullptr, {"root/b: x"}},
        {"root/a", nullptr, {"root/b: x", "root/a: x"}},
        {"root/b", nullptr, {"root/b: x", "root/a: x"}}, // two filters: still one delivery
        {nullptr, "root/b", {"root/b: x", "root/a: x"}},
        {nullptr, "root/unknown", {"root/b: x", "root/a: x"}},
        {nullptr, "root/b", {"root/a: x"}},
        {nullptr, "root/a", {}},
    };
    ASSERT_EQ(enable(), CMPI_RC_OK);
    for (const auto& step : steps)
    {
        if (step.activated)
            activate(step.activated);
        if (step.deactivated)
            deactivate(step.deactivated);
        inbox.alerts.clear();
        EXPECT_TRUE(raise("x"));
        EXPECT_EQ(inbox.alerts, step.alerts);
    }
    EXPECT_FALSE(script.handler->handle(nullptr)) << "the end of delivery";
}

TEST_F(Indications, are_enabled_once_and_disabled_once)
{
    const struct
    {
        bool on;
        int provider_status;
        CMPIrc rc;
        int enables, disables; // calls of the provider so far
    } steps[] = {
        {false, DISABLE_INDICATIONS_OK, CMPI_RC_OK, 0, 0}, // never enabled: the provider is not asked
        {true, ENABLE_INDICATIONS_FAILED, CMPI_RC_ERR_FAILED, 1, 0},
        {false, DISABLE_INDICATIONS_OK, CMPI_RC_OK, 1, 0},
        {true, ENABLE_INDICATIONS_OK, CMPI_RC_OK, 2, 0}, // the failed attempt left nothing enabled
        {true, ENABLE_INDICATIONS_FAILED, CMPI_RC_OK, 2, 0},
        {false, DISABLE_INDICATIONS_FAILED, CMPI_RC_ERR_FAILED, 2, 1},
        {false, DISABLE_INDICATIONS_FAILED, CMPI_RC_OK, 2, 1},
        {true, -1, CMPI_RC_OK, 3, 1},
        {false, -1, CMPI_RC_OK, 3, 2},
    };
    for (const auto& step : steps)
    {
        script.enable_indications = static_cast<Enable_Indications_Status>(step.provider_status);
        script.disable_indications = static_cast<Disable_Indications_Status>(step.provider_status);
        EXPECT_EQ(step.on ? enable() : disable(), step.rc) << &step - steps;
        EXPECT_EQ(script.enables, step.enables) << &step - steps;
        EXPECT_EQ(script.disables, step.disables) << &step - steps;
    }
    script.on_enable = [] { throw std::runtime_error("enable"); };
    EXPECT_EQ(enable(), CMPI_RC_ERR_FAILED);
    script.on_enable = nullptr;
    EXPECT_EQ(enable(), CMPI_RC_OK);
}

TEST_F(Indications, go_on_when_the_server_refuses_one)
{
    ASSERT_EQ(enable(), CMPI_RC_OK);
    activate("root/a");
    EXPECT_THAT(logged([&] { raise("x"); }, "DBG"), ElementsAre("CMPI_Adapter: delivering an indication to root/a"));
    inbox.on_delivery = [] { throw std::runtime_error("full"); };
    EXPECT_THAT(logged([&] { EXPECT_TRUE(raise("x")); }),
                ElementsAre("Converter: No ObjectPath built before call to make_CMPI_instance",
                            "CMPI_Adapter: CBDeliverIndication() failed: CMPI_RC_ERR_FAILED"));
}

TEST_F(Indications, of_a_thread_that_waits_for_a_request_do_not_hold_up_the_disabling)
{
    Provider_Thread delivery;
    script.on_disable = [&]
    {
        // The thread is certain to wait for the adapter: this request holds it, or lets go of it.
        const int before = raised;
        while (raised < before + 3)
            std::this_thread::yield();
        delivery.join();
    };
    deliver_from(delivery);
    EXPECT_EQ(disable(), CMPI_RC_OK);
    EXPECT_EQ(inbox.count, raised);
}

TEST_F(Indications, end_with_a_cleanup_while_they_are_enabled)
{
    Provider_Thread delivery;
    script.on_unload = [&]
    {
        delivery.join();
        script.handler.reset();
    };
    deliver_from(delivery);
    EXPECT_EQ(clean_up(), CMPI_RC_OK);
    EXPECT_EQ(script.providers, 0);
}

TEST_F(Indications, are_not_switched_nor_cleaned_up_from_within_the_provider)
{
    std::vector<CMPIrc> answers;
    inbox.on_delivery = [&] { answers = {enable(), disable(), clean_up()}; };
    activate("root/a");
    ASSERT_EQ(enable(), CMPI_RC_OK);
    EXPECT_TRUE(raise("x"));
    EXPECT_THAT(answers, ElementsAre(CMPI_RC_ERR_FAILED, CMPI_RC_ERR_FAILED, CMPI_RC_DO_NOT_UNLOAD));
    EXPECT_EQ(disable(), CMPI_RC_OK);
    EXPECT_EQ(script.disables, 1);
    EXPECT_EQ(clean_up(), CMPI_RC_OK);
}

// A server that counts what its threads do, and may be told that it is gone.
struct Thread_Counts
{
    std::atomic<int> prepared, attached, detached;
    CMPIContext* context; // of the last thread prepared
};
Thread_Counts counts;

class Provider_Threads : public Indications
{
protected:
    Provider_Threads()
    {
        counts.prepared = counts.attached = counts.detached = 0;
        calls.prepareAttachThread = [](const CMPIBroker* b, const CMPIContext* context)
        { return ++counts.prepared, counts.context = cimserver::broker_table.prepareAttachThread(b, context); };
        calls.attachThread = [](const CMPIBroker* b, const CMPIContext* context)
        { return ++counts.attached, cimserver::broker_table.attachThread(b, context); };
        calls.detachThread = [](const CMPIBroker* b, const CMPIContext* context)
        { return ++counts.detached, cimserver::broker_table.detachThread(b, context); };
        server.bft = &calls;
        alert_data.adapter->broker = &server;
    }

    CMPIBroker server = *broker.face();
    CMPIBrokerFT calls = *broker.face()->bft;
};

TEST_F(Provider_Threads, attach_to_the_server_and_detach)
{
    Provider_Thread thread;
    const auto body = []
    {
        EXPECT_EQ(counts.attached, 1);
        EXPECT_EQ(counts.detached, 0);
        String user;
        EXPECT_TRUE(cimom::get_username(user));
        EXPECT_EQ(user, "root");
    };
    enable_with(thread, body);
    thread.join();
    EXPECT_EQ(counts.prepared, 1);
    EXPECT_EQ(counts.detached, 1);
}

TEST_F(Provider_Threads, that_outlive_the_adapter_leave_the_broker_alone)
{
    Provider_Thread thread;
    std::atomic<bool> gone = false;
    const auto outlive = [&]
    {
        while (!gone)
            std::this_thread::yield();
        String user;
        Instance_Enumerator e;
        const auto model = thing("a");
        Thread other;
        EXPECT_FALSE(cimom::get_username(user));
        EXPECT_EQ(cimom::enum_instances(name_space, model.ptr(), e), -1);
        EXPECT_FALSE(cimom::get_instance(name_space, model.ptr()));
        EXPECT_EQ(cimom::create_instance(name_space, model.ptr()), -1);
        EXPECT_EQ(cimom::allow_unload(false), 0);
        const auto top = [](void*) -> void* { return Thread_Context::top(); };
        EXPECT_EQ(Thread::create_joinable(other, top, nullptr), 0);
        void* context = &other;
        Thread::join(other, context);
        EXPECT_EQ(context, nullptr) << "a thread that it starts has none";
    };
    enable_with(thread, outlive);
    while (counts.attached == 0)
        std::this_thread::yield();
    EXPECT_EQ(clean_up(), CMPI_RC_OK);
    server = {};
    gone = true;
    thread.join();
    EXPECT_EQ(counts.detached, 0);
    CMRelease(counts.context); // as a server does that goes
}

TEST_F(Provider_Threads, are_waited_for_while_they_use_the_broker)
{
    static std::atomic<bool> entered, left;
    entered = left = false;
    calls.enumerateInstances = [](auto...) -> CMPIEnumeration*
    {
        entered = true;
        Time::sleep(20 * Time::MSEC);
        left = true;
        return nullptr;
    };
    Provider_Thread thread;
    const auto body = []
    {
        Instance_Enumerator e;
        cimom::enum_instances(name_space, thing("a").ptr(), e);
    };
    enable_with(thread, body);
    while (!entered)
        std::this_thread::yield();
    EXPECT_EQ(clean_up(), CMPI_RC_OK);
    EXPECT_TRUE(left);
    thread.join();
    if (counts.detached == 0)
        CMRelease(counts.context); // as a server does that goes
}

TEST_F(Provider_Threads, that_cannot_attach_leave_the_broker_alone)
{
    static bool throws;
    calls.attachThread = [](auto...) { return throws ? throw 1 : CMPIStatus{CMPI_RC_ERR_FAILED, nullptr}; };
    activate("root/a");
    const auto body = [&]
    {
        String user;
        EXPECT_FALSE(cimom::get_username(user));
        EXPECT_FALSE(script.handler->handle(alert("lost")));
    };
    for (const bool how : {false, true})
    {
        throws = how;
        Provider_Thread thread;
        EXPECT_THAT(logged([&] { enable_with(thread, body), thread.join(); }, "ERR"),
                    testing::Contains("CMPI_Thread_Context: CBAttachThread() failed: CMPI_RC_ERR_FAILED"));
        EXPECT_EQ(disable(), CMPI_RC_OK);
    }
    EXPECT_EQ(counts.detached, 0);
    EXPECT_EQ(inbox.count, 0);
}

using Indications_Death_Test = Indications;

TEST_F(Indications_Death_Test, raised_outside_a_thread_context_are_an_internal_error)
{
    ASSERT_EQ(enable(), CMPI_RC_OK);
    EXPECT_DEATH(script.handler->handle(alert("x")), "assert: thread_context != 0\n\n");
}

} // namespace
