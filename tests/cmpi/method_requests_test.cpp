// The method interface as a server calls it.
#include "cimserver/broker/cmpi_values.h"
#include "cimserver/broker/objects.h"
#include "cmpi/cmpi_objects.h"
#include "tests/cmpi/served_provider.h"

#include <cmpimacs.h>
#include <gmock/gmock.h>

using namespace test;
using cimserver::Args_Object;
using testing::IsEmpty;
using testing::SizeIs;

namespace
{

class Method_Requests : public Served_Provider
{
protected:
    CMPIrc invoke(const char* method, const CMPIObjectPath* object) { return invoke(method, object, in.face(), out.face()); }
    CMPIrc invoke(const char* method, const CMPIObjectPath* object, const CMPIArgs* args, CMPIArgs* outputs)
    {
        result.clear();
        return CMPI_Adapter::invokeMethod(mi, request.context(), result.face(), object, method, args, outputs).rc;
    }
    static cimserver::Value embedded(const char* name)
    {
        const std::vector<cimserver::Named_Value> properties = {{"Name", string(name)},
                                                                {"Uint8Value", {CMPI_uint8, std::uint64_t{3}}}};
        const cimserver::Instance instance = {{"", "", "TST_Thing", {}}, properties};
        return {CMPI_instance, instance};
    }
    CMPIObjectPath* disk_path() const { return thing_path("disk", "TST_Disk"); }

    CMPIMethodMI* mi = methods();
    Args_Object& in = cimserver::make<Args_Object>();
    Args_Object& out = cimserver::make<Args_Object>();
    Recorded_Result result;
};

TEST_F(Method_Requests, carry_parameters_of_every_kind_there_and_back)
{
    const cimserver::Value text = string(" a \"b\\ ");
    in.args = {{"LEVEL", {CMPI_uint8, std::uint64_t{7}}},
               {"Texts", {CMPI_string | CMPI_ARRAY, std::vector<cimserver::Value>{text}}},
               {"Partner", reference("tst_disk", "partner")}, // declared on the superclass
               {"Others", {CMPI_ref | CMPI_ARRAY, std::vector<cimserver::Value>{reference("TST_Thing", "other")}}},
               {"Detail", embedded("detail")},
               {"Details", {CMPI_instance | CMPI_ARRAY, std::vector<cimserver::Value>{embedded("detail")}}},
               {"Count", {CMPI_sint64, std::int64_t{-5}}},
               {"Answer", text}}; // no input: ignored
    script.on_invoke = [&](Instance* parameters)
    {
        auto& p = *static_cast<TST_Disk_Convert_method*>(parameters);
        EXPECT_EQ(p.Level.value, 7);
        EXPECT_EQ(p.Texts.value[0], " a \"b\\ ");
        ASSERT_TRUE(p.Partner);
        EXPECT_EQ(p.Partner->meta_class, &TST_Disk::static_meta_class);
        EXPECT_EQ(p.Partner->__name_space, name_space) << "a reference's own name space is not the module's";
        ASSERT_EQ(p.Others.value.size(), 1U);
        EXPECT_EQ(cast<TST_Thing>(p.Others.value[0])->Name.value, "other");
        ASSERT_TRUE(p.Detail);
        EXPECT_EQ(p.Detail->Uint8Value.value, 3) << "all of it, not only its keys";
        ASSERT_EQ(p.Details.value.size(), 1U);
        EXPECT_EQ(cast<TST_Thing>(p.Details.value[0])->Uint8Value.value, 3);
        EXPECT_EQ(p.Details.value[0]->__name_space, name_space);
        EXPECT_EQ(p.Count.value, -5);
        EXPECT_TRUE(p.Answer.null && p.Numbers.null && p.return_value.null);
        p.Count.set(p.Count.value - 1);
        p.Numbers.set({1, 0xFFFF});
        p.Found = thing("found").steal();
        p.return_value.set("done");
    };
    static const CMPIObjectPath* last_made;
    CMPIBrokerEncFT table = cimserver::encapsulation_table;
    table.newObjectPath = [](auto... arguments)
    {
        auto* made = cimserver::encapsulation_table.newObjectPath(arguments...);
        last_made = made;
        return made;
    };
    CMPIBroker server = *broker.face();
    server.eft = &table;
    disk_data.adapter->broker = &server;
    EXPECT_EQ(invoke("convert", disk_path()), CMPI_RC_OK);
    EXPECT_EQ(class_name_of(last_made), "TST_Thing") << "a server may keep what it is handed: it lives until the request ends";
    EXPECT_EQ(cast<TST_Disk>(script.instance.ptr())->Name.value, "disk");
    ASSERT_THAT(result.data, SizeIs(1));
    EXPECT_EQ(result.data[0].type, CMPI_string);
    EXPECT_EQ(result.data[0].get<cimserver::Text>(), "done");
    EXPECT_EQ(result.done, 1);

    ASSERT_THAT(out.args, SizeIs(5)) << "neither the return value nor null outputs are arguments";
    EXPECT_EQ(content<std::int64_t>(out.args, "Count"), -6);
    EXPECT_THAT(content<std::vector<cimserver::Value>>(out.args, "Numbers"), SizeIs(2));
    EXPECT_EQ(value(out.args, "Detail").type, CMPI_instance);
    EXPECT_EQ(value(out.args, "Details").type, CMPI_instance | CMPI_ARRAY);
    EXPECT_EQ(name_in(path_in(out.args, "Found")), "found");
    EXPECT_EQ(path_in(out.args, "Found").name_space, name_space);
}

TEST_F(Method_Requests, return_what_the_provider_sets_whatever_its_status_says_but_a_failure)
{
    script.on_invoke = [](Instance* parameters) { static_cast<TST_Disk_Reset_method*>(parameters)->return_value.set(4); };
    for (const auto& [status, rc] : {std::pair(0, CMPI_RC_OK), {-1, CMPI_RC_OK}, {130, CMPI_RC_ERR_FAILED}})
    {
        script.invoke_method = static_cast<Invoke_Method_Status>(status);
        EXPECT_EQ(invoke("Reset", path("TST_Disk"), nullptr, nullptr), rc) << status;
        EXPECT_THAT(result.data, SizeIs(rc == CMPI_RC_OK ? 1 : 0)) << status;
        EXPECT_EQ(result.done, rc == CMPI_RC_OK ? 1 : 0) << status;
    }
    script.invoke_method = INVOKE_METHOD_OK;
    script.on_invoke = nullptr;
    EXPECT_EQ(invoke("Reset", path("TST_Disk")), CMPI_RC_OK);
    EXPECT_THAT(result.data, IsEmpty()) << "a method that sets no value returns none";
}

TEST_F(Method_Requests, fail_before_the_provider_is_asked)
{
    script.on_invoke = [](Instance*) { FAIL(); };
    EXPECT_EQ(invoke("Convert", path("TST_Unknown")), CMPI_RC_ERR_FAILED);
    EXPECT_EQ(invoke("Convert", path("TST_Pair")), CMPI_RC_ERR_FAILED) << "a class of another provider";
    EXPECT_EQ(invoke("Reset", disk_path()), CMPI_RC_ERR_FAILED) << "static, but called on an instance";
    EXPECT_EQ(invoke("Invert", disk_path()), CMPI_RC_ERR_METHOD_NOT_FOUND);
    EXPECT_EQ(invoke("Name", disk_path()), CMPI_RC_ERR_METHOD_NOT_FOUND);
    EXPECT_EQ(invoke(nullptr, disk_path()), CMPI_RC_ERR_METHOD_NOT_FOUND);
}

TEST_F(Method_Requests, leave_arguments_null_that_do_not_fit)
{
    script.on_invoke = [](Instance* parameters)
    {
        const auto& p = *static_cast<TST_Disk_Convert_method*>(parameters);
        EXPECT_TRUE(p.Level.null && p.Others.null && !p.Partner);
    };
    const std::pair<cimserver::Named_Value, std::size_t> cases[] = {
        {{"Others", {CMPI_boolean, {}}}, 0}, // how servers deliver an untyped null
        {{"Others", {CMPI_boolean, true}}, 0},
        {{"Partner", {CMPI_boolean, {}}}, 2},
        {{"Partner", reference("TST_Pair", "x")}, 3},
        {{"Level", {CMPI_uint16, std::uint64_t{1}}}, 2},
        {{"Unknown", {CMPI_uint16, std::uint64_t{1}}}, 1},
    };
    for (const auto& [argument, messages] : cases)
    {
        in.args = {argument};
        EXPECT_THAT(logged([&] { EXPECT_EQ(invoke("Convert", disk_path()), CMPI_RC_OK); }), SizeIs(messages))
            << argument.name.string();
    }
}

} // namespace
