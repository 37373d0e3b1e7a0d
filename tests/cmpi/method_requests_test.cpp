// The method interface as a server calls it.
#include "cimserver/broker/conversion.h"
#include "cimserver/broker/objects.h"
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
    CMPIObjectPath* disk_path() const { return thing_path("disk", "Test_Disk"); }

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
               {"Partner", reference("test_disk", "partner")}, // declared on the superclass
               {"Others", {CMPI_ref | CMPI_ARRAY, std::vector<cimserver::Value>{reference("Test_Thing", "other")}}},
               {"Count", {CMPI_sint64, std::int64_t{-5}}},
               {"Answer", text}}; // no input: ignored
    script.on_invoke = [&](Instance* parameters)
    {
        auto& p = *static_cast<Test_Disk_Convert_method*>(parameters);
        EXPECT_EQ(p.Level.value, 7);
        EXPECT_EQ(p.Texts.value[0], " a \"b\\ ");
        ASSERT_TRUE(p.Partner);
        EXPECT_EQ(p.Partner->meta_class, &Test_Disk::static_meta_class);
        EXPECT_EQ(p.Partner->__name_space, name_space) << "a reference's own name space is not the module's";
        ASSERT_EQ(p.Others.value.size(), 1U);
        EXPECT_EQ(cast<Test_Thing>(p.Others.value[0])->Name.value, "other");
        EXPECT_EQ(p.Count.value, -5);
        EXPECT_TRUE(p.Answer.null && p.Numbers.null && p.return_value.null);
        p.Count.set(p.Count.value - 1);
        p.Numbers.set({1, 0xFFFF});
        p.Found = thing("found").steal();
        p.return_value.set("done");
    };
    EXPECT_EQ(invoke("convert", disk_path()), CMPI_RC_OK);
    EXPECT_EQ(cast<Test_Disk>(script.instance.ptr())->Name.value, "disk");
    ASSERT_THAT(result.data, SizeIs(1));
    EXPECT_EQ(result.data[0].type, CMPI_string);
    EXPECT_EQ(std::get<std::string>(result.data[0].content), "done");
    EXPECT_EQ(result.done, 1);

    ASSERT_THAT(out.args, SizeIs(3)) << "neither the return value nor null outputs are arguments";
    EXPECT_EQ(content<std::int64_t>(out.args, "Count"), -6);
    EXPECT_THAT(content<std::vector<cimserver::Value>>(out.args, "Numbers"), SizeIs(2));
    EXPECT_EQ(name_in(path_in(out.args, "Found")), "found");
    EXPECT_EQ(path_in(out.args, "Found").name_space, name_space);
}

TEST_F(Method_Requests, answer_each_status)
{
    const std::pair<Invoke_Method_Status, CMPIrc> rows[] = {
        {INVOKE_METHOD_OK, CMPI_RC_OK},
        {INVOKE_METHOD_FAILED, CMPI_RC_ERR_FAILED},
        {INVOKE_METHOD_UNSUPPORTED, CMPI_RC_ERR_NOT_SUPPORTED},
        {INVOKE_METHOD_ACCESS_DENIED, CMPI_RC_ERR_ACCESS_DENIED},
        {static_cast<Invoke_Method_Status>(-1), CMPI_RC_OK},
    };
    script.on_invoke = [](Instance* parameters) { static_cast<Test_Disk_Reset_method*>(parameters)->return_value.set(4); };
    for (const auto& [status, rc] : rows)
    {
        script.invoke_method = status;
        EXPECT_EQ(invoke("Reset", path("Test_Disk"), nullptr, nullptr), rc) << status;
        EXPECT_THAT(result.data, SizeIs(rc == CMPI_RC_OK ? 1 : 0)) << status;
        EXPECT_EQ(result.done, rc == CMPI_RC_OK ? 1 : 0) << status;
    }
    script.invoke_method = INVOKE_METHOD_OK;
    script.on_invoke = nullptr;
    EXPECT_EQ(invoke("Reset", path("Test_Disk")), CMPI_RC_OK);
    EXPECT_THAT(result.data, IsEmpty()) << "a method that sets no value returns none";
}

TEST_F(Method_Requests, fail_before_the_provider_is_asked)
{
    script.on_invoke = [](Instance*) { FAIL(); };
    EXPECT_EQ(invoke("Convert", path("Test_Unknown")), CMPI_RC_ERR_FAILED);
    EXPECT_EQ(invoke("Convert", path("Test_Link")), CMPI_RC_ERR_FAILED) << "a class of another provider";
    EXPECT_EQ(invoke("Reset", disk_path()), CMPI_RC_ERR_FAILED) << "static, but called on an instance";
    EXPECT_EQ(invoke("Invert", disk_path()), CMPI_RC_ERR_METHOD_NOT_FOUND);
    EXPECT_EQ(invoke("Name", disk_path()), CMPI_RC_ERR_METHOD_NOT_FOUND);
    EXPECT_EQ(invoke(nullptr, disk_path()), CMPI_RC_ERR_METHOD_NOT_FOUND);
}

TEST_F(Method_Requests, leave_arguments_null_that_do_not_fit)
{
    const struct
    {
        cimserver::Named_Value argument;
        std::vector<std::string> messages;
    } cases[] = {
        {{"Others", {CMPI_boolean, {}}}, {}}, // how servers deliver an untyped null
        {{"Others", {CMPI_boolean, true}}, {}},
        {{"Partner", {CMPI_boolean, {}}},
         {"CMPI_Containers: type mismatch on Partner: instance/boolean", "Container: conversion error: Convert.Partner"}},
        {{"Partner", reference("Test_Link", "x")},
         {"Container: unknown feature: Test_Link.Name", "Value: failed to assign instance of Test_Link to Convert.Partner",
          "Container: conversion error: Convert.Partner"}},
        {{"Level", {CMPI_uint16, std::uint64_t{1}}},
         {"CMPI_Containers: type mismatch on Level: uint8/uint16", "Container: conversion error: Convert.Level"}},
        {{"Unknown", {CMPI_uint16, std::uint64_t{1}}}, {"Container: unknown feature: Convert.Unknown"}},
    };
    script.on_invoke = [](Instance* parameters)
    {
        const auto& p = *static_cast<Test_Disk_Convert_method*>(parameters);
        EXPECT_TRUE(p.Level.null && p.Others.null && !p.Partner);
    };
    for (const auto& c : cases)
    {
        in.args = {c.argument};
        EXPECT_EQ(logged([&] { EXPECT_EQ(invoke("Convert", disk_path()), CMPI_RC_OK); }), c.messages) << c.argument.name;
    }
}

} // namespace
