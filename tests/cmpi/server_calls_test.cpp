// The calls of providers into the server: the facade, and what reaches the server's operations.
#include "cimserver/broker/objects.h"
#include "cmpi/cimom.h"
#include "cmpi/thread_context.h"
#include "tests/cmpi/served_provider.h"

#include <cmpimacs.h>
#include <gmock/gmock.h>

using namespace test;
using testing::Each;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{

// The server's side: writes down what it is asked, and answers what the test offers.
struct Server
{
    std::vector<cimserver::Instance> instances;
    std::vector<cimserver::Named_Value> arguments;
    std::vector<std::string> calls;
    CMPIrc rc = CMPI_RC_OK;

    CMPIrc asked(const std::string& call, const CMPIObjectPath* to)
    {
        const auto& path = cimserver::object<cimserver::Path_Object>(to).path;
        calls.push_back(call + " " + path.name_space + ":" + path.class_name.string() + "." +
                        path.keys.at(0).value.get<cimserver::Text>().string());
        return rc;
    }
};
Server server;

using B = const CMPIBroker*;
using C = const CMPIContext*;
using O = const CMPIObjectPath*;
using I = const CMPIInstance*;
using L = const char**;

CMPIInstance* face_of(const cimserver::Instance& instance)
{
    return cimserver::make<cimserver::Instance_Object>(instance).face();
}

CMPIEnumeration* enumerate(B, C, O path, L, CMPIStatus* status)
{
    status->rc = server.asked("enumerate", path);
    std::vector<cimserver::Value> elements;
    for (const auto& instance : server.instances)
        elements.push_back({CMPI_instance, instance});
    return cimserver::make<cimserver::Enumeration_Object>(elements).face();
}
CMPIInstance* get(B, C, O path, L, CMPIStatus* status)
{
    status->rc = server.asked("get", path);
    return server.instances.empty() ? nullptr : face_of(server.instances[0]);
}
CMPIObjectPath* create_instance(B, C, O path, I, CMPIStatus* status)
{
    status->rc = server.asked("create", path);
    return CMClone(path, nullptr);
}
CMPIData invoke(B, C, O path, const char* method, const CMPIArgs* in, CMPIArgs* out, CMPIStatus* status)
{
    status->rc = server.asked(method, path);
    server.arguments = cimserver::object<cimserver::Args_Object>(in).args;
    cimserver::object<cimserver::Args_Object>(out).args = {{"Count", {CMPI_sint64, std::int64_t{9}}}, {"Answer", string("yes")}};
    return {CMPI_string, CMPI_goodValue, {.string = cimserver::make<cimserver::String_Object>(std::string("done")).face()}};
}

CMPIBrokerFT operations(CMPIBrokerFT table)
{
    table.enumerateInstances = enumerate;
    table.getInstance = get;
    table.createInstance = create_instance;
    table.modifyInstance = [](B, C, O path, I, L) { return CMPIStatus{server.asked("modify", path), nullptr}; };
    table.deleteInstance = [](B, C, O path) { return CMPIStatus{server.asked("delete", path), nullptr}; };
    table.invokeMethod = invoke;
    return table;
}

cimserver::Instance instance_of(const char* class_name, const char* name)
{
    const cimserver::Named_Value key = {"Name", string(name)};
    return {{"", "root/there", class_name, {key}}, {key, {"Uint8Value", {CMPI_uint8, std::uint64_t{3}}}}};
}

class Server_Calls : public Served_Provider
{
protected:
    Server_Calls()
    {
        server = {};
        odd.bft = &table;
    }

    void TearDown() override
    {
        model.reset();
        method.reset();
        Served_Provider::TearDown();
    }

    // Runs work() as a provider does in a request to a broker.
    template <class Work> void in_request(Work work)
    {
        const CMPI_Thread_Context_Pusher pusher(&odd, request.context(), thing_data.adapter);
        work();
    }

    // Calls every operation: the answers, 0 or -1.
    std::vector<int> call_all()
    {
        const char* there = "root/there";
        Instance_Enumerator e;
        return {cimom::get_instance(there, model.ptr()) ? 0 : -1,
                cimom::create_instance(there, model.ptr()),
                cimom::modify_instance(there, model.ptr()),
                cimom::delete_instance(there, model.ptr()),
                cimom::invoke_method(there, model.ptr(), method.ptr()),
                cimom::enum_instances(there, model.ptr(), e)};
    }

    CMPIBrokerFT table = operations(*broker.face()->bft);
    CMPIBroker odd = *broker.face();
    CMPIInstanceMI* mi = things();
    Ref<TST_Thing> model = thing("a");
    Ref<TST_Disk_Convert_method> method{
        static_cast<TST_Disk_Convert_method*>(create(&TST_Disk_Convert_method::static_meta_class))};
};

TEST_F(Server_Calls, enumerate_as_instances_of_the_models_class)
{
    server.instances = {instance_of("TST_Thing", "x"), instance_of("TST_Disk", "y")};
    const auto work = [&]
    {
        Instance_Enumerator e;
        EXPECT_FALSE(e);
        for (int round = 0; round < 2; ++round) // an enumerator may be used again
        {
            ASSERT_EQ(cimom::enum_instances("root/there", model.ptr(), e), 0);
            std::vector<std::string> names;
            for (; e; ++e)
            {
                const Ref<Instance> found = e();
                EXPECT_EQ(found->meta_class, &TST_Thing::static_meta_class);
                EXPECT_EQ(found->__name_space, "root/there");
                EXPECT_EQ(cast<TST_Thing>(found.ptr())->Uint8Value.value, 3);
                names.emplace_back(cast<TST_Thing>(found.ptr())->Name.value.c_str());
            }
            EXPECT_THAT(names, ElementsAre("x", "y"));
        }
        server.instances.clear();
        EXPECT_EQ(cimom::enum_instances("root/there", model.ptr(), e), 0);
        EXPECT_FALSE(e);
    };
    in_request(work);
}

TEST_F(Server_Calls, end_an_enumeration_at_what_is_no_instance)
{
    table.enumerateInstances = [](B, C, O, L, CMPIStatus*)
    {
        const std::vector<cimserver::Value> elements = {string("no instance")};
        return cimserver::make<cimserver::Enumeration_Object>(elements).face();
    };
    const auto work = [&]
    {
        Instance_Enumerator e;
        EXPECT_EQ(cimom::enum_instances("root/there", model.ptr(), e), 0);
        EXPECT_FALSE(e);
    };
    in_request(work);
}

TEST_F(Server_Calls, reach_each_operation)
{
    server.instances = {instance_of("TST_Thing", "x")};
    nullify_properties(method.ptr());
    method->Level.set(7);
    method->Count.set(1);
    method->Numbers.set({1});
    in_request([&] { EXPECT_THAT(call_all(), Each(0)); });
    EXPECT_THAT(server.calls, ElementsAre("get root/there:TST_Thing.a", "create root/there:TST_Thing.a",
                                          "modify root/there:TST_Thing.a", "delete root/there:TST_Thing.a",
                                          "Convert root/there:TST_Thing.a", "enumerate root/there:TST_Thing.a"));
    EXPECT_THAT(names_of(server.arguments), ElementsAre("Level", "Count")) << "the inputs that are set";
    EXPECT_EQ(method->Level.value, 7);
    EXPECT_EQ(method->Count.value, 9);
    EXPECT_EQ(method->Answer.value, "yes");
    EXPECT_EQ(method->return_value.value, "done");
    EXPECT_TRUE(method->Numbers.null) << "an output that the server does not give";
}

TEST_F(Server_Calls, fail_when_the_server_refuses_and_without_a_context)
{
    server.rc = CMPI_RC_ERR_ACCESS_DENIED;
    in_request([&] { EXPECT_THAT(call_all(), Each(-1)); });
    server.rc = CMPI_RC_OK;
    server.calls.clear();
    String user;
    EXPECT_THAT(call_all(), Each(-1));
    EXPECT_EQ(cimom::allow_unload(false), -1);
    EXPECT_FALSE(cimom::get_username(user));
    EXPECT_THAT(server.calls, IsEmpty());
}

TEST_F(Server_Calls, keep_the_provider_and_tell_the_user)
{
    in_request([] { EXPECT_EQ(cimom::allow_unload(false), 0); });
    EXPECT_EQ(mi->ft->cleanup(mi, request.context(), 0).rc, CMPI_RC_DO_NOT_UNLOAD);
    in_request([] { cimom::allow_unload(true); });

    String user;
    in_request([&] { EXPECT_TRUE(cimom::get_username(user)); });
    EXPECT_EQ(user, "root");

    auto& empty = cimserver::make<cimserver::Context_Object>();
    const CMPI_Thread_Context_Pusher pusher(broker.face(), empty.face(), thing_data.adapter);
    EXPECT_THAT(logged([&] { EXPECT_FALSE(cimom::get_username(user)); }, "ERR"),
                ElementsAre("CMPI_Thread_Context: username not OK cmpirc=6"));
    EXPECT_EQ(user, "root");
}

} // namespace
