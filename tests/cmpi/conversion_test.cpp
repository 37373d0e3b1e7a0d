// What instances become on the wire, and what comes back from it.
#include "cimserver/broker/objects.h"
#include "cmpi/cmpi_containers.h"
#include "cmpi/converter.h"
#include "schema/TST_Keyed.h"
#include "tests/cmpi/served_provider.h"

#include <cmpimacs.h>
#include <gmock/gmock.h>

#include <malloc.h>
#include <set>
#include <sys/mman.h>

using namespace test;
using cimserver::Array_Object;
using cimserver::Instance_Object;
using cimserver::make;
using cimserver::Named_Value;
using cimserver::Path_Object;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;

namespace
{

using Values = std::vector<cimserver::Value>;

class Conversion : public Served_Provider
{
protected:
    CMPI_Ptr<CMPIInstance> to_cmpi(const Instance* instance)
    {
        CMPI_Ptr<CMPIInstance> made;
        EXPECT_EQ(make_cmpi_instance(broker.face(), share(instance), name_space, nullptr, nullptr, made), CMPI_RC_OK);
        return made;
    }

    template <class T> Ref<T> from_cmpi(const CMPIInstance* cmpi_instance)
    {
        Ref<Instance> made;
        const auto* object_path = path(T::static_meta_class.name);
        EXPECT_EQ(make_cimple_instance(broker.face(), &T::static_meta_class, object_path, cmpi_instance, made), CMPI_RC_OK);
        return Ref<T>(static_cast<T*>(made.steal()));
    }

    // Out of properties that need not fit the class.
    template <class T> Ref<T> instance_of(std::vector<Named_Value> properties)
    {
        return from_cmpi<T>(make<Instance_Object>(cimserver::Instance{{}, std::move(properties)}).face());
    }
};

TEST_F(Conversion, leaves_bad_items_null_and_says_why)
{
    const std::string at_name = "Container: conversion error: TST_Thing.Name";
    const std::string not_taken = "CMPI_Containers: cmpi_to_cimple_value() failed";
    const struct
    {
        Named_Value item;
        std::vector<std::string> messages;
    } cases[] = {
        {{"Unknown", string("x")}, {"Container: unknown feature: TST_Thing.Unknown"}},
        {{"Uint16Value", {CMPI_uint32, std::uint64_t{1}}},
         {"CMPI_Containers: type mismatch on Uint16Value: uint16/uint32", "Container: conversion error: TST_Thing.Uint16Value"}},
        {{"uint8values", {CMPI_uint8, std::uint64_t{1}}},
         {"CMPI_Containers: type mismatch on uint8values: uint8_array/uint8",
          "Container: conversion error: TST_Thing.uint8values"}},
        {{"Uint8Value", {CMPI_uint8, {}}}, {}},
        {{"Uint8Values", {CMPI_uint8 | CMPI_ARRAY, {}}}, {}},
        {{"Name", reference("TST_Thing", "x")}, {"CMPI_Containers: type mismatch on Name: string/instance", at_name}},
        {{"Name", reference("TST_Nobody", "x")},
         {"Converter: failed to find meta class: TST_Nobody", "Converter: failed to create CIMPLE instance", not_taken, at_name}},
        {{"StringValues", {CMPI_string | CMPI_ARRAY, Values{string("a"), {CMPI_string, {}}}}},
         {"Converter: encountered null array element", not_taken, "Container: conversion error: TST_Thing.StringValues"}},
    };
    for (const auto& c : cases)
    {
        Ref<TST_Thing> made;
        const auto convert = [&] { made = instance_of<TST_Thing>({c.item, {"Sint64Value", {CMPI_sint64, std::int64_t{5}}}}); };
        EXPECT_EQ(logged(convert), c.messages) << c.item.name.string();
        EXPECT_THAT(non_null_of(made.ptr()), ElementsAre("Sint64Value"));
    }
}

TEST_F(Conversion, leaves_no_object_with_the_broker_in_a_long_request)
{
    const Ref<TST_Pair> references = linked("a", "b");
    const Ref<TST_Thing> values = full_thing("all");
    const auto convert = [&](int times)
    {
        for (int i = 0; i < times; ++i)
        {
            to_cmpi(references.ptr());
            to_cmpi(values.ptr());
        }
    };
    convert(10);
    const std::size_t before = mallinfo2().uordblks;
    convert(2'000);
    EXPECT_LT(mallinfo2().uordblks, before + 50'000);
}

// ---- what cannot be converted ----

// Counts of a server that cannot count; and how often it is asked for an item.
int fetched;
constexpr auto no_count = [](auto, CMPIStatus* status) -> CMPICount
{
    *status = {CMPI_RC_ERR_FAILED, nullptr};
    return 0xFFFFFFFF;
};

TEST_F(Conversion, fails_when_the_server_cannot_count_and_fetches_each_item_once)
{
    const Meta_Class* meta_class = &TST_Disk::static_meta_class;
    Ref<Instance> made;
    CMPIInstanceFT properties = Instance_Object::table;
    CMPIObjectPathFT keys = Path_Object::table;
    CMPIArgsFT arguments = cimserver::Args_Object::table;
    const CMPIInstance instance = {&properties, &properties};
    const CMPIObjectPath object_path = {&keys, &keys};
    const CMPIArgs args = {&arguments, &arguments};
    properties.getPropertyCount = no_count;
    keys.getKeyCount = no_count;
    arguments.getArgCount = no_count;
    const auto convert = [&] { return make_cimple_instance(broker.face(), meta_class, path("TST_Disk"), &instance, made); };
    EXPECT_EQ(convert(), CMPI_RC_ERR_FAILED);
    EXPECT_EQ(make_cimple_reference(broker.face(), meta_class, &object_path, made), CMPI_RC_ERR_FAILED);
    EXPECT_EQ(make_cimple_method(broker.face(), meta_class, find_method(meta_class, "Convert"), path("TST_Disk"), &args, made),
              CMPI_RC_ERR_FAILED);

    fetched = 0;
    properties.getPropertyCount = [](auto...) { return CMPICount{3}; };
    properties.getPropertyAt = [](const CMPIInstance*, CMPICount, CMPIString** name, CMPIStatus*)
    {
        ++fetched;
        *name = make<cimserver::String_Object>(std::string("Uint8Value")).face();
        return CMPIData{CMPI_uint8, CMPI_goodValue, {.uint8 = 7}};
    };
    EXPECT_EQ(convert(), CMPI_RC_OK);
    EXPECT_EQ(fetched, 3);
}

TEST_F(Conversion, refuses_data_that_are_no_value)
{
    const auto of_array = [](CMPIType declared, CMPIType type, Values elements) -> CMPIData
    {
        return {static_cast<CMPIType>(declared | CMPI_ARRAY),
                CMPI_goodValue,
                {.array = make<Array_Object>(type, std::move(elements)).face()}};
    };
    static constexpr CMPIValue zeros = {.uint64 = 0};
    const cimserver::Value number = {CMPI_uint8, std::uint64_t{1}};
    const CMPIData refused[] = {
        {CMPI_args, CMPI_goodValue, zeros},
        {CMPI_chars, CMPI_goodValue, zeros},
        {CMPI_null, CMPI_goodValue, zeros},
        {CMPI_dateTime, CMPI_goodValue, zeros},
        {CMPI_ref, CMPI_goodValue, zeros},
        {CMPI_instance, CMPI_goodValue, zeros},
        {CMPI_uint8 | CMPI_ARRAY, CMPI_goodValue, zeros},
        {CMPI_ref | CMPI_ARRAY, CMPI_goodValue, zeros},
        {CMPI_instance,
         CMPI_goodValue,
         {.inst = make<Instance_Object>(cimserver::Instance{{"", "", "TST_Nobody", {}}, {}}).face()}},
        of_array(CMPI_uint16, CMPI_uint8, {number}),
        of_array(CMPI_string, CMPI_string, {string("a"), {CMPI_string, {}}}),
        of_array(CMPI_ref, CMPI_string, {string("a")}),
        of_array(CMPI_ref, CMPI_ref, {{CMPI_ref, {}}}),
        of_array(CMPI_ref, CMPI_ref, {reference("TST_Nobody", "x")}),
    };
    for (const CMPIData& data : refused)
    {
        Value made;
        const auto convert = [&]
        { EXPECT_EQ(cmpi_to_cimple_value(&meta_repository(), broker.face(), name_space, data, made), -1) << &data - refused; };
        EXPECT_THAT(logged(convert), Not(IsEmpty())) << &data - refused;
    }
    Value made;
    const auto convert = [&]
    {
        cmpi_to_cimple_value(&meta_repository(), broker.face(), name_space, {CMPI_string, CMPI_goodValue, zeros}, made);
        EXPECT_EQ(*made.get_if<String>(), "");
    };
    EXPECT_THAT(logged(convert, "INFO"), ElementsAre("Converter: ignored null CMPI string"));
}

// A path that is its own key: as deep as no stack.
TEST_F(Conversion, ends_where_objects_are_nested_without_end)
{
    static CMPIObjectPathFT keys = Path_Object::table;
    static CMPIObjectPath endless = {&keys, &keys};
    static const CMPIData data = {CMPI_ref, CMPI_goodValue, {.ref = &endless}};
    static constexpr auto text = [](const char* chars) { return make<cimserver::String_Object>(std::string(chars)).face(); };
    keys.getKeyCount = [](auto...) { return CMPICount{1}; };
    keys.getClassName = [](auto...) { return text("TST_Pair"); };
    keys.getKeyAt = [](const CMPIObjectPath*, CMPICount, CMPIString** name, CMPIStatus*)
    {
        *name = text("Antecedent");
        return data;
    };
    Value made;
    const auto convert = [&] { cmpi_to_cimple_value(&meta_repository(), broker.face(), name_space, data, made); };
    EXPECT_EQ(logged(convert).front(), "Converter: failed to create CIMPLE instance");
    EXPECT_EQ(made.type(), Value::INSTANCE);
}

TEST_F(Conversion, refuses_values_that_are_nothing_to_a_server)
{
    Value none, null_instance, homeless;
    null_instance.set_value(static_cast<Instance*>(nullptr));
    homeless.set_value(static_cast<Instance*>(thing("a").steal()));
    for (const Value* value : {&none, &null_instance, &homeless})
    {
        CMPI_Data data;
        const auto convert = [&] { EXPECT_EQ(_to_cmpi_data(&meta_repository(), broker.face(), "", *value, 0, data), -1); };
        EXPECT_THAT(logged(convert), SizeIs(1));
    }
}

// ---- a server whose calls fail ----

int calls_until_failure;  // negative: none fails
bool failure_with_object; // what fails answers an object all the same

template <class Table> Table original; // the broker's own

template <auto member> struct Call;
template <class Table, class Result, class... Arguments, Result (*Table::*member)(Arguments...)> struct Call<member>
{
    static Result run(Arguments... arguments)
    {
        if (calls_until_failure-- != 0)
            return (original<Table>.*member)(arguments...);
        if constexpr (std::is_same_v<Result, CMPIStatus>)
            return {CMPI_RC_ERR_NOT_SUPPORTED, nullptr};
        else
        {
            const Result made = failure_with_object ? (original<Table>.*member)(arguments...) : Result{};
            const int asked = (set_status(arguments) + ...);
            return asked > 0 ? made : Result{}; // who does not ask for the status would take it
        }
    }

    template <class T> static int set_status(T argument)
    {
        if constexpr (std::is_same_v<T, CMPIStatus*>)
            if (argument)
            {
                *argument = {CMPI_RC_ERR_NOT_SUPPORTED, nullptr};
                return 1;
            }
        return 0;
    }
};

// Functions of a table of the broker that fail at the chosen call. The broker knows its objects by their tables: those, which
// are constant, are changed themselves.
template <auto... members, class Table> void let_fail(const Table& table)
{
    auto* page = reinterpret_cast<char*>(reinterpret_cast<std::uintptr_t>(&table) & ~std::uintptr_t{4095});
    ASSERT_EQ(mprotect(page, 2 * 4096, PROT_READ | PROT_WRITE), 0);
    original<Table> = table;
    ((const_cast<Table&>(table).*members = Call<members>::run), ...);
}

// Every single call fails in turn, until the work does without a failure. What is left behind, the sanitizers report.
TEST_F(Conversion, tells_of_every_call_that_fails)
{
    using E = CMPIBrokerEncFT;
    using I = CMPIInstanceFT;
    using P = CMPIObjectPathFT;
    calls_until_failure = -1;
    let_fail<&E::newInstance, &E::newObjectPath, &E::newArgs, &E::newString, &E::newArray, &E::newDateTimeFromChars>(
        *broker.face()->eft);
    let_fail<&I::setProperty, &I::setPropertyFilter, &I::getPropertyCount, &I::getPropertyAt, &I::getObjectPath>(
        Instance_Object::table);
    let_fail<&P::addKey, &P::getKeyCount, &P::getKeyAt, &P::getClassName>(Path_Object::table);
    let_fail<&CMPIArgsFT::addArg, &CMPIArgsFT::getArgAt>(cimserver::Args_Object::table);
    let_fail<&CMPIArrayFT::setElementAt, &CMPIArrayFT::getSize, &CMPIArrayFT::getElementAt>(Array_Object::table);
    let_fail<&CMPIStringFT::getCharPtr>(cimserver::String_Object::table);
    let_fail<&CMPIDateTimeFT::getStringFormat>(cimserver::Datetime_Object::table);

    const Ref<TST_Pair> sent = linked("a", "b");
    const Ref<TST_Disk_Convert_method> method(
        static_cast<TST_Disk_Convert_method*>(create(&TST_Disk_Convert_method::static_meta_class)));
    method->return_value.set("done");
    method->Detail = full_thing("detail").steal();
    const char* list[] = {"Note", nullptr};
    std::set<CMPIrc> codes;
    const auto there = [&]() -> CMPIrc
    {
        CMPI_Ptr<CMPIObjectPath> path;
        CMPI_Ptr<CMPIInstance> made;
        CMPI_Data return_value;
        const CMPI_Ptr<CMPIArgs> args(CMNewArgs(broker.face(), nullptr));
        CMPIrc rc = args ? make_cmpi_object_path(broker.face(), sent.ptr(), name_space, path) : CMPI_RC_ERR_FAILED;
        if (rc == CMPI_RC_OK)
            rc = make_cmpi_instance(broker.face(), share(sent.ptr()), name_space, path.get(), list, made);
        if (rc == CMPI_RC_OK)
            rc = make_cmpi_object(broker.face(), share(sent.ptr()), name_space, list, made);
        if (rc == CMPI_RC_OK)
            rc = make_cmpi_method(broker.face(), name_space, method.ptr(), args.get(), return_value);
        return rc;
    };
    const auto whole = to_cmpi(sent.ptr());
    const auto values = to_cmpi(full_thing("all").ptr());
    const CMPI_Ptr<CMPIArgs> arguments(CMNewArgs(broker.face(), nullptr));
    CMPI_Data return_value;
    make_cmpi_method(broker.face(), name_space, method.ptr(), arguments.get(), return_value);
    const CMPIObjectPath* pairs = path("TST_Pair");
    const auto back = [&]
    {
        Ref<Instance> made;
        CMPIrc rc = make_cimple_instance(broker.face(), sent->meta_class, pairs, whole.get(), made);
        if (rc == CMPI_RC_OK)
            rc = make_cimple_instance(broker.face(), &TST_Thing::static_meta_class, pairs, values.get(), made);
        return rc == CMPI_RC_OK ? make_cimple_method(broker.face(), sent->meta_class, &TST_Disk_Convert_method::static_meta_class,
                                                     pairs, arguments.get(), made)
                                : rc;
    };
    const std::function<CMPIrc()> works[] = {there, back};
    for (int i = 0; i < 4; ++i)
    {
        const auto& work = works[i / 2];
        failure_with_object = i % 2 != 0;
        bool failed = true;
        for (int call = 0; failed; ++call)
        {
            calls_until_failure = call;
            CMPIrc rc = CMPI_RC_OK;
            const auto messages = logged([&] { rc = work(); });
            failed = calls_until_failure < 0;
            calls_until_failure = -1;
            EXPECT_EQ(failed, rc != CMPI_RC_OK || !messages.empty()) << "call " << call;
            codes.insert(rc);
        }
    }
    EXPECT_THAT(codes, ElementsAre(CMPI_RC_OK, CMPI_RC_ERR_FAILED, CMPI_RC_ERR_NOT_SUPPORTED)) << "the filter's own code";

    // A key that the path does not take is a property all the same.
    Ref<TST_Keyed> keyed(TST_Keyed::create());
    keyed->Name.set("key");
    keyed->Count.set(7);
    CMPI_Ptr<CMPIInstance> made;
    calls_until_failure = 2; // behind the path and the key's text
    EXPECT_EQ(make_cmpi_object(broker.face(), Ref<Instance>(keyed.steal()), name_space, nullptr, made), CMPI_RC_OK);
    EXPECT_STREQ(CMGetCharsPtr(CMGetProperty(made.get(), "Name", nullptr).value.string, nullptr), "key");
    EXPECT_EQ(CMGetProperty(made.get(), "Count", nullptr).value.uint8, 7);
}

} // namespace
