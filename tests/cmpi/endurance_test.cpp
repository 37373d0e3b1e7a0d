// Many requests, and many threads: nothing is left behind, nothing is lost. ENDURANCE_ROUNDS is how many times each kind of
// request is made.
#include "cimserver/broker/objects.h"
#include "runtime/log.h"
#include "tests/cmpi/served_provider.h"
#include "tests/runtime/resources.h"

#include <cmpimacs.h>
#include <gmock/gmock.h>

#include <thread>

using namespace test;

namespace
{

// Forgets what it is given.
class Drain : public cimserver::Result_Sink, public cimserver::Indication_Sink
{
public:
    void take_instance(const cimserver::Instance_Object&) override {}
    void take_path(const cimserver::Object_Path&) override {}
    void take_data(const cimserver::Value&) override {}
    void deliver(const std::string&, const cimserver::Instance&) override {}
};

// A thing with a value of each kind that the broker makes an object for: more would only take longer.
Ref<TST_Thing> small_thing(const char* name)
{
    Ref<TST_Thing> result = thing(name);
    result->DatetimeValue.set(Datetime(7));
    result->StringValues.set({"one"});
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

// One request of each kind. Each answers CMPI_RC_OK.
struct Kind
{
    const char* name;
    std::function<CMPIrc(Call&)> run;
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
            auto& p = *static_cast<TST_Disk_Convert_method*>(parameters);
            p.Numbers.set({1, 2});
            p.Found = thing("found").steal();
            p.return_value.set("done");
        };
    }
    ~Endurance() override { log_set_level("DBG"); }

    CMPIObjectPath* b() const { return thing_path("b"); }
    CMPIObjectPath* alert_path() const { return path("TST_Alert"); }
    CMPIInstance* new_thing() const
    {
        CMPIInstance* instance = CMNewInstance(broker.face(), b(), nullptr);
        CMSetProperty(instance, "Name", "new", CMPI_chars);
        return instance;
    }
    std::vector<Kind> instance_kinds();
    std::vector<Kind> other_kinds();
    std::vector<Kind> kinds()
    {
        auto all = instance_kinds();
        const auto others = other_kinds();
        all.insert(all.end(), others.begin(), others.end());
        return all;
    }

    using A = CMPI_Adapter;
    Drain drain;
    CMPIInstanceMI* mi = things();
    CMPIMethodMI* method_mi = methods();
    CMPIAssociationMI* link_mi = associations();
    CMPIIndicationMI* alert_mi = alerts();
};

const char* list[] = {"StringValues", "DatetimeValue", nullptr};

std::vector<Kind> Endurance::instance_kinds()
{
    return {
        {"enumerateInstanceNames", [this](Call& c) { return A::enumInstanceNames(mi, c.context, c.result, b()).rc; }},
        {"enumerateInstances", [this](Call& c) { return A::enumInstances(mi, c.context, c.result, b(), nullptr).rc; }},
        {"getInstance", [this](Call& c) { return A::getInstance(mi, c.context, c.result, b(), list).rc; }},
        {"createInstance", [this](Call& c) { return A::createInstance(mi, c.context, c.result, b(), new_thing()).rc; }},
        {"modifyInstance", [this](Call& c) { return A::modifyInstance(mi, c.context, c.result, b(), new_thing(), list).rc; }},
        {"deleteInstance", [this](Call& c) { return A::deleteInstance(mi, c.context, c.result, b()).rc; }},
        {"unknown class",
         [this](Call& c)
         {
             const CMPIrc rc = A::enumInstances(mi, c.context, c.result, path("Unknown"), nullptr).rc;
             return rc == CMPI_RC_ERR_FAILED ? CMPI_RC_OK : CMPI_RC_ERROR;
         }},
        {"factory, cleanup",
         [this](Call& c)
         {
             auto* disks = interface<CMPIInstanceMI>('I', disk_data, disk_registration);
             return disks->ft->cleanup(disks, c.context, 0).rc;
         }},
    };
}

std::vector<Kind> Endurance::other_kinds()
{
    return {
        {"invokeMethod",
         [this](Call& c)
         {
             CMPIArgs* in = CMNewArgs(broker.face(), nullptr);
             CMPIObjectPath* partner = b();
             CMAddArg(in, "Partner", &partner, CMPI_ref);
             CMPIArgs* out = CMNewArgs(broker.face(), nullptr);
             return A::invokeMethod(method_mi, c.context, c.result, thing_path("d", "TST_Disk"), "Convert", in, out).rc;
         }},
        {"associators",
         [this](Call& c) { return A::associators(link_mi, c.context, c.result, b(), "TST_Pair", "", "", "", list).rc; }},
        {"associatorNames",
         [this](Call& c) { return A::associatorNames(link_mi, c.context, c.result, b(), "TST_Pair", "", "", "").rc; }},
        {"references", [this](Call& c) { return A::references(link_mi, c.context, c.result, b(), "TST_Pair", "", list).rc; }},
        {"referenceNames", [this](Call& c) { return A::referenceNames(link_mi, c.context, c.result, b(), "TST_Pair", "").rc; }},
        {"filters",
         [this](Call& c)
         {
             A::authorizeFilter(alert_mi, c.context, nullptr, "", alert_path(), "");
             A::activateFilter(alert_mi, c.context, nullptr, "", alert_path(), 1);
             return A::deactivateFilter(alert_mi, c.context, nullptr, "", alert_path(), 1).rc;
         }},
        {"enable, disable",
         [this](Call& c)
         {
             const CMPIrc rc = A::enableIndications(alert_mi, c.context).rc;
             return rc == CMPI_RC_OK ? A::disableIndications(alert_mi, c.context).rc : rc;
         }},
    };
}

TEST_F(Endurance, every_kind_of_request_leaves_heap_threads_and_descriptors_as_they_were)
{
    for (const Kind& kind : kinds())
    {
        const auto run = [&]
        {
            Call call(drain);
            ASSERT_EQ(kind.run(call), CMPI_RC_OK) << kind.name;
        };
        sample::repeat(ENDURANCE_ROUNDS / 100, run);
        const sample::Resources before;
        sample::repeat(ENDURANCE_ROUNDS, run);
        EXPECT_EQ(sample::Resources(), before) << kind.name;
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
    ASSERT_EQ(mi->ft->cleanup(mi, request.context(), 0).rc, CMPI_RC_OK);
    std::vector<std::thread> threads;
    for (int t = 0; t < 16; ++t)
        threads.emplace_back(
            [&]
            {
                for (int i = 0; i < 50; ++i)
                {
                    Call call(drain);
                    auto* own = things();
                    EXPECT_EQ(A::enumInstances(own, call.context, call.result, path("TST_Thing"), nullptr).rc, CMPI_RC_OK);
                    EXPECT_EQ(A::instanceCleanup(own, call.context, 0).rc, CMPI_RC_OK);
                }
            });
    for (std::thread& thread : threads)
        thread.join();
    EXPECT_EQ(thing_data.adapter, nullptr);
}

} // namespace
