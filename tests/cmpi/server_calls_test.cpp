// The calls of providers into the server: the facade, and what reaches the server's operations.
#include "cimserver/operations.h"
#include "cmpi/cimom.h"
#include "cmpi/thread_context.h"
#include "tests/cmpi/served_provider.h"

#include <gmock/gmock.h>

using namespace test;
using cimserver::Cim_Error;
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
        return {{CMPI_string, std::string("done")},
                {{"Count", {CMPI_sint64, std::int64_t{9}}}, {"Answer", {CMPI_string, std::string("yes")}}}};
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
    const cimserver::Named_Value key = {"Name", {CMPI_string, std::string(name)}};
    return {{"", "root/there", class_name, {key}}, {key, {"Uint8", {CMPI_uint8, std::uint64_t{3}}}}};
}

class Server_Calls : public Served_Provider
{
protected:
    Server_Calls() { broker.set_operations(&server); }

    void TearDown() override
    {
        model.reset();
        Served_Provider::TearDown();
    }

    // Runs work() as a provider does in a request.
    template <class Work> void in_request(Work work)
    {
        const CMPI_Thread_Context_Pusher pusher(broker.face(), request.context(), thing_data.adapter);
        work();
    }

    Server server;
    CMPIInstanceMI* mi = things();
    Ref<Test_Thing> model = thing("a");
};

TEST_F(Server_Calls, enumerate_as_instances_of_the_models_class)
{
    server.instances = {instance_of("Test_Thing", "x"), instance_of("Test_Disk", "y")};
    in_request(
        [&]
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
        });
    EXPECT_EQ(server.calls.at(0), "enumerate root/there:Test_Thing");
}

TEST_F(Server_Calls, end_an_enumeration_at_what_is_no_instance)
{
    CMPIBrokerFT calls = *broker.face()->bft;
    calls.enumerateInstances = [](const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char**, CMPIStatus* status)
    {
        *status = {CMPI_RC_OK, nullptr};
        return cimserver::make<cimserver::Enumeration_Object>(
                   CMPIType{CMPI_string}, std::vector<cimserver::Value>{{CMPI_string, std::string("no instance")}})
            .face();
    };
    CMPIBroker odd = *broker.face();
    odd.bft = &calls;
    const CMPI_Thread_Context_Pusher pusher(&odd, request.context(), thing_data.adapter);
    Instance_Enumerator e;
    EXPECT_EQ(cimom::enum_instances("root/there", model.ptr(), e), 0);
    EXPECT_FALSE(e);
}

TEST_F(Server_Calls, reach_each_operation)
{
    server.instances = {instance_of("Test_Thing", "x")};
    Ref<Test_Disk_Convert_method> method(
        static_cast<Test_Disk_Convert_method*>(create(&Test_Disk_Convert_method::static_meta_class)));
    nullify_properties(method.ptr());
    method->Level.set(7);
    method->Count.set(1);
    method->Numbers.set({1});
    for (const bool fails : {false, true})
    {
        server.fails = fails;
        in_request(
            [&]
            {
                const int rc = fails ? -1 : 0;
                const Ref<Instance> found = cimom::get_instance("root/there", model.ptr());
                EXPECT_EQ(!found, fails);
                EXPECT_EQ(cimom::create_instance("root/there", model.ptr()), rc);
                EXPECT_EQ(cimom::modify_instance("root/there", model.ptr()), rc);
                EXPECT_EQ(cimom::delete_instance("root/there", model.ptr()), rc);
                EXPECT_EQ(cimom::invoke_method("root/there", model.ptr(), method.ptr()), rc);
                Instance_Enumerator e;
                EXPECT_EQ(cimom::enum_instances("root/there", model.ptr(), e), rc);
            });
    }
    server.calls.resize(6);
    EXPECT_THAT(server.calls, ElementsAre("get root/there:Test_Thing.a", "create root/there:Test_Thing.a",
                                          "modify root/there:Test_Thing.a", "delete root/there:Test_Thing.a",
                                          "invoke root/there:Test_Thing.a Convert", "enumerate root/there:Test_Thing"));
    ASSERT_THAT(server.arguments, testing::SizeIs(2)) << "the inputs that are set";
    EXPECT_EQ(method->Level.value, 7);
    EXPECT_EQ(method->Count.value, 9);
    EXPECT_EQ(method->Answer.value, "yes");
    EXPECT_EQ(method->return_value.value, "done");
    EXPECT_EQ(method->Numbers.null, 1) << "an output that the server does not give";
}

TEST_F(Server_Calls, fail_without_a_context)
{
    Instance_Enumerator e;
    String user;
    EXPECT_EQ(cimom::enum_instances("root/there", model.ptr(), e), -1);
    EXPECT_FALSE(cimom::get_instance("root/there", model.ptr()));
    EXPECT_EQ(cimom::create_instance("root/there", model.ptr()), -1);
    EXPECT_EQ(cimom::modify_instance("root/there", model.ptr()), -1);
    EXPECT_EQ(cimom::delete_instance("root/there", model.ptr()), -1);
    EXPECT_EQ(cimom::invoke_method("root/there", model.ptr(), model.ptr()), -1);
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
