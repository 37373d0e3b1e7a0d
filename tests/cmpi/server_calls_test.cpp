// The calls of providers into the server: the facade, and what reaches the server's operations.
#include "cimserver/operations.h"
#include "cmpi/cimom.h"
#include "cmpi/thread_context.h"
#include "tests/cmpi/served_provider.h"

#include <gmock/gmock.h>

using namespace test;
using cimserver::Cim_Error;
using testing::Each;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{

// The server's side: answers what the test offers and keeps what it is given.
class Server : public cimserver::Operations
{
public:
    const zmlr::Meta_Class* get_class(const std::string&, const std::string&) override { return nullptr; }
    std::vector<const zmlr::Meta_Class*> enumerate_classes(const std::string&, const std::string&, bool) override { return {}; }
    std::vector<cimserver::Object_Path> enumerate_instance_names(const std::string&, const std::string&) override { return {}; }
    std::vector<cimserver::Instance> enumerate_instances(const std::string& name_space, const std::string& class_name, bool,
                                                         const cimserver::Property_List& properties) override
    {
        EXPECT_FALSE(properties);
        answer("enumerate " + name_space + ":" + class_name);
        return instances;
    }
    cimserver::Instance get_instance(const cimserver::Object_Path& path, const cimserver::Property_List&) override
    {
        answer("get " + text_of(path));
        return instances.at(0);
    }
    cimserver::Object_Path create_instance(const cimserver::Instance& instance) override
    {
        answer("create " + text_of(instance.path));
        return instance.path;
    }
    void modify_instance(const cimserver::Instance& instance, const cimserver::Property_List& properties) override
    {
        EXPECT_FALSE(properties);
        answer("modify " + text_of(instance.path));
    }
    void delete_instance(const cimserver::Object_Path& path) override { answer("delete " + text_of(path)); }
    cimserver::Method_Result invoke_method(const cimserver::Object_Path& path, const std::string& method,
                                           const std::vector<cimserver::Named_Value>& in) override
    {
        answer("invoke " + text_of(path) + " " + method);
        arguments = in;
        return {string("done"), {{"Count", {CMPI_sint64, std::int64_t{9}}}, {"Answer", string("yes")}}};
    }

    std::vector<cimserver::Instance> instances;
    std::vector<cimserver::Named_Value> arguments;
    std::vector<std::string> calls;
    bool fails = false;

private:
    static std::string text_of(const cimserver::Object_Path& path)
    {
        return path.name_space + ":" + path.class_name + "." + std::get<std::string>(path.keys.at(0).value.content);
    }
    void answer(const std::string& call)
    {
        calls.push_back(call);
        if (fails)
            throw Cim_Error(cimserver::CIM_ERR_ACCESS_DENIED, "no");
    }
};

cimserver::Instance instance_of(const char* class_name, const char* name)
{
    const cimserver::Named_Value key = {"Name", string(name)};
    return {{"", "root/there", class_name, {key}}, {key, {"Uint8", {CMPI_uint8, std::uint64_t{3}}}}};
}

class Server_Calls : public Served_Provider
{
protected:
    Server_Calls() { broker.set_operations(&server); }

    void TearDown() override
    {
        model.reset();
        method.reset();
        Served_Provider::TearDown();
    }

    // Runs work() as a provider does in a request to a broker.
    template <class Work> void in_request(Work work) { in_request(*broker.face(), work); }
    template <class Work> void in_request(const CMPIBroker& to, Work work)
    {
        const CMPI_Thread_Context_Pusher pusher(&to, request.context(), thing_data.adapter);
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

    Server server;
    CMPIInstanceMI* mi = things();
    Ref<Test_Thing> model = thing("a");
    Ref<Test_Disk_Convert_method> method{
        static_cast<Test_Disk_Convert_method*>(create(&Test_Disk_Convert_method::static_meta_class))};
};

TEST_F(Server_Calls, enumerate_as_instances_of_the_models_class)
{
    server.instances = {instance_of("Test_Thing", "x"), instance_of("Test_Disk", "y")};
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
                EXPECT_EQ(found->meta_class, &Test_Thing::static_meta_class);
                EXPECT_EQ(found->__name_space, "root/there");
                EXPECT_EQ(cast<Test_Thing>(found.ptr())->Uint8.value, 3);
                names.emplace_back(cast<Test_Thing>(found.ptr())->Name.value.c_str());
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
    CMPIBrokerFT calls = *broker.face()->bft;
    calls.enumerateInstances = [](const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char**, CMPIStatus* status)
    {
        *status = {CMPI_RC_OK, nullptr};
        const std::vector<cimserver::Value> elements = {string("no instance")};
        return cimserver::make<cimserver::Enumeration_Object>(CMPIType{CMPI_string}, elements).face();
    };
    CMPIBroker odd = *broker.face();
    odd.bft = &calls;
    const auto work = [&]
    {
        Instance_Enumerator e;
        EXPECT_EQ(cimom::enum_instances("root/there", model.ptr(), e), 0);
        EXPECT_FALSE(e);
    };
    in_request(odd, work);
}

TEST_F(Server_Calls, reach_each_operation)
{
    server.instances = {instance_of("Test_Thing", "x")};
    nullify_properties(method.ptr());
    method->Level.set(7);
    method->Count.set(1);
    method->Numbers.set({1});
    in_request([&] { EXPECT_THAT(call_all(), Each(0)); });
    EXPECT_THAT(server.calls, ElementsAre("get root/there:Test_Thing.a", "create root/there:Test_Thing.a",
                                          "modify root/there:Test_Thing.a", "delete root/there:Test_Thing.a",
                                          "invoke root/there:Test_Thing.a Convert", "enumerate root/there:Test_Thing"));
    EXPECT_THAT(names_of(server.arguments), ElementsAre("Level", "Count")) << "the inputs that are set";
    EXPECT_EQ(method->Level.value, 7);
    EXPECT_EQ(method->Count.value, 9);
    EXPECT_EQ(method->Answer.value, "yes");
    EXPECT_EQ(method->return_value.value, "done");
    EXPECT_TRUE(method->Numbers.null) << "an output that the server does not give";
}

TEST_F(Server_Calls, fail_when_the_server_refuses_and_without_a_context)
{
    server.fails = true;
    in_request([&] { EXPECT_THAT(call_all(), Each(-1)); });
    server.fails = false;
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
