// Many requests, and many threads: nothing is left behind, nothing is lost. ENDURANCE_ROUNDS is how many times each kind of
// request is made.
#include "cimserver/broker/objects.h"
#include "cmpi/cimom.h"
#include "cmpi/thread_context.h"
#include "runtime/log.h"
#include "tests/cmpi/served_provider.h"

#include <cmpimacs.h>
#include <gmock/gmock.h>

#include <atomic>
#include <dirent.h>
#include <malloc.h>
#include <thread>

using namespace test;

namespace
{

std::size_t entries_of(const char* folder)
{
    std::size_t count = 0;
    DIR* stream = opendir(folder);
    while (readdir(stream))
        ++count;
    closedir(stream);
    return count;
}

struct Resources
{
    std::size_t heap = mallinfo2().uordblks;
    std::size_t threads = entries_of("/proc/self/task");
    std::size_t descriptors = entries_of("/proc/self/fd");
};

// Forgets what it is given.
class Drain : public cimserver::Result_Sink, public cimserver::Indication_Sink
{
public:
    void take_instance(const cimserver::Instance_Object&) override {}
    void take_path(const cimserver::Object_Path&) override {}
    void take_data(const cimserver::Value&) override {}
    void deliver(const std::string&, const cimserver::Instance&) override {}
};

// A thing with a value of each kind that the broker makes an object for.
Ref<Test_Thing> small_thing(const char* name)
{
    Ref<Test_Thing> result = thing(name);
    result->When.set(Datetime(7));
    result->Strings.set({"one"});
    return result;
}

// A request as a server makes it: everything that the broker makes for it goes with it.
struct Call
{
    cimserver::Request request;
    const CMPIContext* context = request.context();
    const CMPIResult* result;

    explicit Call(Drain& drain) : result(cimserver::make<cimserver::Result_Object>(drain).face()) {}
};

class Endurance : public Served_Provider
{
protected:
    Endurance()
    {
        log_set_level("FATAL");
        broker.set_indication_sink(&drain);
        script.instances.emplace_back(small_thing("b").steal());
        script.create_instance = CREATE_INSTANCE_OK;
        script.modify_instance = MODIFY_INSTANCE_OK;
        script.delete_instance = DELETE_INSTANCE_OK;
        script.enum_references = ENUM_REFERENCES_OK;
        script.enum_associators = ENUM_ASSOCIATORS_OK;
        script.enum_associator_names = ENUM_ASSOCIATOR_NAMES_OK;
        script.associators.emplace_back(small_thing("far").steal());
        script.on_invoke = [](Instance* parameters)
        {
            auto& p = *static_cast<Test_Disk_Convert_method*>(parameters);
            p.Numbers.set({1, 2});
            p.Found = thing("found").steal();
            p.return_value.set("done");
        };
    }
    ~Endurance() override { log_set_level("DBG"); }

    CMPIObjectPath* alert_path() const { return path("Test_Alert"); }

    // One request of each kind. Each answers the code.
    struct Kind
    {
        const char* name;
        std::function<CMPIrc(Call&)> run;
    };
    std::vector<Kind> kinds();

    Drain drain;
    CMPIInstanceMI* thing_mi = things();
    CMPIMethodMI* method_mi = methods();
    CMPIAssociationMI* link_mi = associations();
    CMPIIndicationMI* alert_mi = alerts();
};

CMPIInstance* new_thing(const CMPIBroker* broker, const CMPIObjectPath* path)
{
    CMPIInstance* instance = CMNewInstance(broker, path, nullptr);
    CMPISint8 number = 3;
    CMSetProperty(instance, "Name", "new", CMPI_chars);
    CMSetProperty(instance, "Sint8", &number, CMPI_sint8);
    return instance;
}

std::vector<Endurance::Kind> Endurance::kinds()
{
    static const char* list[] = {"Strings", "When", nullptr};
    const auto object = [this] { return thing_path("b"); };
    // clang-format off
    return {
        {"enumerateInstanceNames", [=, this](Call& c) { return CMPI_Adapter::enumInstanceNames(thing_mi, c.context, c.result, object()).rc; }},
        {"enumerateInstances", [=, this](Call& c) { return CMPI_Adapter::enumInstances(thing_mi, c.context, c.result, object(), nullptr).rc; }},
        {"getInstance", [=, this](Call& c) { return CMPI_Adapter::getInstance(thing_mi, c.context, c.result, object(), list).rc; }},
        {"createInstance", [=, this](Call& c) { return CMPI_Adapter::createInstance(thing_mi, c.context, c.result, object(), new_thing(broker.face(), object())).rc; }},
        {"modifyInstance", [=, this](Call& c) { return CMPI_Adapter::modifyInstance(thing_mi, c.context, c.result, object(), new_thing(broker.face(), object()), list).rc; }},
        {"deleteInstance", [=, this](Call& c) { return CMPI_Adapter::deleteInstance(thing_mi, c.context, c.result, object()).rc; }},
        {"unknown class", [=, this](Call& c) { return CMPI_Adapter::enumInstances(thing_mi, c.context, c.result, path("Unknown"), nullptr).rc == CMPI_RC_ERR_FAILED ? CMPI_RC_OK : CMPI_RC_ERROR; }},
        {"invokeMethod", [=, this](Call& c)
            {
                CMPIArgs* in = CMNewArgs(broker.face(), nullptr);
                CMPIObjectPath* partner = object();
                CMAddArg(in, "Partner", &partner, CMPI_ref);
                return CMPI_Adapter::invokeMethod(method_mi, c.context, c.result, thing_path("d", "Test_Disk"), "Convert", in, CMNewArgs(broker.face(), nullptr)).rc;
            }},
        {"associators", [=, this](Call& c) { return CMPI_Adapter::associators(link_mi, c.context, c.result, object(), "Test_Link", "", "", "", list).rc; }},
        {"associatorNames", [=, this](Call& c) { return CMPI_Adapter::associatorNames(link_mi, c.context, c.result, object(), "Test_Link", "", "", "").rc; }},
        {"references", [=, this](Call& c) { return CMPI_Adapter::references(link_mi, c.context, c.result, object(), "Test_Link", "", list).rc; }},
        {"referenceNames", [=, this](Call& c) { return CMPI_Adapter::referenceNames(link_mi, c.context, c.result, object(), "Test_Link", "").rc; }},
        {"filters", [=, this](Call& c)
            {
                CMPI_Adapter::authorizeFilter(alert_mi, c.context, nullptr, "", alert_path(), "");
                CMPI_Adapter::activateFilter(alert_mi, c.context, nullptr, "", alert_path(), 1);
                return CMPI_Adapter::deactivateFilter(alert_mi, c.context, nullptr, "", alert_path(), 1).rc;
            }},
        {"enable, disable", [=, this](Call& c)
            {
                const CMPIrc rc = CMPI_Adapter::enableIndications(alert_mi, c.context).rc;
                return rc == CMPI_RC_OK ? CMPI_Adapter::disableIndications(alert_mi, c.context).rc : rc;
            }},
        {"factory, cleanup", [this](Call& c)
            {
                auto* mi = interface<CMPIInstanceMI>('I', disk_data, disk_registration);
                return mi->ft->cleanup(mi, c.context, 0).rc;
            }},
    };
    // clang-format on
}

TEST_F(Endurance, every_kind_of_request_leaves_heap_threads_and_descriptors_as_they_were)
{
    for (const Kind& kind : kinds())
    {
        const auto run = [&](int rounds)
        {
            for (int i = 0; i < rounds; ++i)
            {
                Call call(drain);
                ASSERT_EQ(kind.run(call), CMPI_RC_OK) << kind.name;
            }
        };
        run(ENDURANCE_ROUNDS / 100);
        const Resources before;
        run(ENDURANCE_ROUNDS);
        const Resources after;
        EXPECT_LT(after.heap, before.heap + 1'000) << kind.name;
        EXPECT_EQ(after.threads, before.threads) << kind.name;
        EXPECT_EQ(after.descriptors, before.descriptors) << kind.name;
    }
}

// Every thread makes every kind of request in its own order: on one interface they meet, on several they run side by side.
TEST_F(Endurance, many_threads_share_the_interfaces)
{
    constexpr unsigned num_threads = 16;
    const auto all = kinds();
    std::vector<std::thread> threads;
    for (unsigned t = 0; t < num_threads; ++t)
        threads.emplace_back(
            [&, t]
            {
                for (unsigned i = 0; i < 20 * all.size(); ++i)
                {
                    Call call(drain);
                    const Kind& kind = all[(t + i) % all.size()];
                    ASSERT_EQ(kind.run(call), CMPI_RC_OK) << kind.name;
                }
            });
    for (std::thread& thread : threads)
        thread.join();
}

// The last interface is given up again and again while others are asked for.
TEST_F(Endurance, interfaces_come_and_go_in_many_threads)
{
    ASSERT_EQ(thing_mi->ft->cleanup(thing_mi, request.context(), 0).rc, CMPI_RC_OK);
    std::vector<std::thread> threads;
    for (int t = 0; t < 16; ++t)
        threads.emplace_back(
            [&]
            {
                for (int i = 0; i < 50; ++i)
                {
                    Call call(drain);
                    void* made = nullptr;
                    cimple_cmpi_adapter('C', &thing_data, &thing_registration, broker.face(), call.context,
                                        thing_registration.provider_name, 'I', &made);
                    auto* mi = static_cast<CMPIInstanceMI*>(made);
                    EXPECT_EQ(CMPI_Adapter::enumInstances(mi, call.context, call.result, path("Test_Thing"), nullptr).rc,
                              CMPI_RC_OK);
                    EXPECT_EQ(CMPI_Adapter::instanceCleanup(mi, call.context, 0).rc, CMPI_RC_OK);
                }
            });
    for (std::thread& thread : threads)
        thread.join();
    EXPECT_EQ(thing_data.adapter, nullptr);
}

} // namespace
