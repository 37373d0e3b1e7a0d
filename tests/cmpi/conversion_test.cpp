// What instances become on the wire, and what comes back from it.
#include "cimserver/broker/objects.h"
#include "cmpi/converter.h"
#include "tests/cmpi/served_provider.h"

#include <gmock/gmock.h>

#include <malloc.h>
#include <stdexcept>

using namespace test;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

namespace
{

using cimserver::Instance_Object;
using cimserver::make;
using cimserver::Named_Value;
using cimserver::Path_Object;

class Conversion : public Served_Provider
{
protected:
    CMPI_Ptr<CMPIInstance> to_cmpi(const Instance* instance)
    {
        CMPI_Ptr<CMPIInstance> made;
        EXPECT_EQ(make_cmpi_instance(broker.face(), instance, name_space, nullptr, nullptr, made), CMPI_RC_OK);
        return made;
    }

    // What the broker holds of an instance.
    cimserver::Instance wire(const Instance* instance)
    {
        const auto made = to_cmpi(instance);
        return cimserver::object<Instance_Object>(made.get()).model();
    }

    template <class T> Ref<T> from_cmpi(const CMPIInstance* cmpi_instance)
    {
        Ref<Instance> made;
        EXPECT_EQ(
            make_cimple_instance(broker.face(), &T::static_meta_class, path(T::static_meta_class.name), cmpi_instance, made),
            CMPI_RC_OK);
        return Ref<T>(static_cast<T*>(made.steal()));
    }

    // A thing out of properties that need not fit its class.
    Ref<Test_Thing> thing_of(std::vector<Named_Value> properties)
    {
        return from_cmpi<Test_Thing>(make<Instance_Object>(cimserver::Instance{{}, std::move(properties)}).face());
    }

    template <class T> Ref<T> from_path(cimserver::Object_Path object_path)
    {
        Ref<Instance> made;
        object_path.name_space = name_space;
        EXPECT_EQ(
            make_cimple_reference(broker.face(), &T::static_meta_class, make<Path_Object>(std::move(object_path)).face(), made),
            CMPI_RC_OK);
        return Ref<T>(static_cast<T*>(made.steal()));
    }
};

cimserver::Value reference(const char* class_name, std::vector<Named_Value> keys)
{
    return {CMPI_ref, std::make_shared<const cimserver::Object_Path>(
                          cimserver::Object_Path{"host", "root/elsewhere", class_name, std::move(keys)})};
}

cimserver::Value string(const char* text) { return {CMPI_string, std::string(text)}; }

TEST_F(Conversion, carries_every_type_there_and_back)
{
    const Ref<Test_Thing> full = full_thing("full");
    full->__name_space = name_space;
    Ref<Test_Thing> sparse = thing("sparse"); // null but for its key and an empty array
    sparse->__name_space = name_space;
    sparse->Strings.set({});
    for (const auto& original : {full, sparse})
    {
        const Ref<Test_Thing> back = from_cmpi<Test_Thing>(to_cmpi(original.ptr()).get());
        EXPECT_TRUE(identical(original.ptr(), back.ptr())) << original->Name.value.c_str();
    }
}

TEST_F(Conversion, gives_every_type_its_code_and_bits)
{
    const auto properties = wire(full_thing("full").ptr()).properties;
    // clang-format off
    const std::pair<const char*, CMPIType> scalars[] = {
        {"Name", CMPI_string}, {"Boolean", CMPI_boolean}, {"Uint8", CMPI_uint8}, {"Sint8", CMPI_sint8},
        {"Uint16", CMPI_uint16}, {"Sint16", CMPI_sint16}, {"Uint32", CMPI_uint32}, {"Sint32", CMPI_sint32},
        {"Uint64", CMPI_uint64}, {"Sint64", CMPI_sint64}, {"Real32", CMPI_real32}, {"Real64", CMPI_real64},
        {"Char16", CMPI_char16}, {"When", CMPI_dateTime}};
    // clang-format on
    for (const auto& [name, type] : scalars)
    {
        EXPECT_EQ(value(properties, name).type, type) << name;
        EXPECT_FALSE(value(properties, name).null()) << name;
    }
    EXPECT_EQ(value(properties, "Sint64s").type, CMPI_sint64 | CMPI_ARRAY);
    EXPECT_EQ(std::get<std::uint64_t>(value(properties, "Uint64").content), 0xFFFFFFFFFFFFFFFF);
    EXPECT_EQ(std::get<std::int64_t>(value(properties, "Sint8").content), -128);
    EXPECT_EQ(std::get<std::uint64_t>(value(properties, "Char16").content), 0x20ACU);
    const auto& strings = std::get<std::vector<cimserver::Value>>(value(properties, "Strings").content);
    ASSERT_THAT(strings, SizeIs(3));
    EXPECT_EQ(std::get<std::string>(strings[2].content), "zw\xC3\xB6lf");

    for (const auto& property : wire(thing("sparse").ptr()).properties)
        EXPECT_EQ(property.value.null(), property.name != "Name") << property.name;
}

TEST_F(Conversion, tells_references_from_embedded_objects)
{
    Ref<Test_Link> original = make_link("a", "b");
    original->Dependent->__name_space = "root/other";
    original->Detail = full_thing("detail").steal();
    original->Others.null = 0;
    original->Others.value.append(full_thing("other").steal());
    original->Details.null = 0;
    original->Details.value.append(full_thing("part").steal());

    const auto properties = wire(original.ptr()).properties;
    EXPECT_EQ(value(properties, "Antecedent").type, CMPI_ref);
    EXPECT_EQ(value(properties, "Detail").type, CMPI_instance);
    EXPECT_EQ(value(properties, "Others").type, CMPI_ref | CMPI_ARRAY);
    EXPECT_EQ(value(properties, "Details").type, CMPI_instance | CMPI_ARRAY);
    const auto& dependent = *std::get<std::shared_ptr<const cimserver::Object_Path>>(value(properties, "Dependent").content);
    EXPECT_EQ(dependent.name_space, "root/other");
    EXPECT_EQ(text(dependent.keys, "Name"), "b");
    const auto& detail = *std::get<std::shared_ptr<const cimserver::Instance>>(value(properties, "Detail").content);
    EXPECT_EQ(text(detail.properties, "When"), "00000000013000.000007:000");

    const Ref<Test_Link> back = from_cmpi<Test_Link>(to_cmpi(original.ptr()).get());
    ASSERT_TRUE(back->Antecedent && back->Detail);
    EXPECT_TRUE(key_eq(back.ptr(), original.ptr()));
    EXPECT_EQ(back->Detail->Uint8.value, 0xFF);
    ASSERT_EQ(back->Others.value.size(), 1U);
    EXPECT_TRUE(cast<Test_Thing>(back->Others.value[0])->Uint8.null) << "a reference holds keys only";
    ASSERT_EQ(back->Details.value.size(), 1U);
    EXPECT_FALSE(cast<Test_Thing>(back->Details.value[0])->Uint8.null);
    EXPECT_EQ(back->Details.value[0]->__name_space, name_space);
}

TEST_F(Conversion, takes_references_out_of_a_path)
{
    const auto key = reference("test_disk", {{"NAME", string("b")}});
    const Ref<Test_Link> made = from_path<Test_Link>({{}, {}, "Test_Link", {{"Dependent", key}, {"Unknown", string("x")}}});
    EXPECT_FALSE(made->Antecedent);
    ASSERT_TRUE(made->Dependent);
    EXPECT_EQ(made->Dependent->meta_class, &Test_Disk::static_meta_class);
    EXPECT_EQ(made->Dependent->Name.value, "b");
    EXPECT_EQ(made->Dependent->Uint8.null, 1);
    EXPECT_EQ(made->__name_space, name_space);
    EXPECT_EQ(made->Dependent->__name_space, name_space);
}

TEST_F(Conversion, leaves_bad_items_null_and_says_why)
{
    using Element = cimserver::Value;
    struct Case
    {
        Named_Value item;
        std::vector<std::string> messages;
    };
    const Case cases[] = {
        {{"Unknown", string("x")}, {"Container: unknown feature: Test_Thing.Unknown"}},
        {{"Uint16", {CMPI_uint32, std::uint64_t{1}}},
         {"CMPI_Containers: type mismatch on Uint16: uint16/uint32", "Container: conversion error: Test_Thing.Uint16"}},
        {{"uint8s", {CMPI_uint8, std::uint64_t{1}}},
         {"CMPI_Containers: type mismatch on uint8s: uint8_array/uint8", "Container: conversion error: Test_Thing.uint8s"}},
        {{"Uint8", {CMPI_uint8, {}}}, {}},
        {{"Uint8s", {CMPI_uint8 | CMPI_ARRAY, {}}}, {}},
        {{"Name", reference("Test_Thing", {})},
         {"CMPI_Containers: type mismatch on Name: string/instance", "Container: conversion error: Test_Thing.Name"}},
        {{"Name", reference("Test_Nobody", {})},
         {"Converter: failed to find meta class: Test_Nobody", "Converter: failed to create CIMPLE instance",
          "CMPI_Containers: cmpi_to_cimple_value() failed", "Container: conversion error: Test_Thing.Name"}},
        {{"Strings", {CMPI_string | CMPI_ARRAY, std::vector<Element>{string("a"), {CMPI_string, {}}}}},
         {"Converter: encountered null array element", "CMPI_Containers: cmpi_to_cimple_value() failed",
          "Container: conversion error: Test_Thing.Strings"}},
    };
    for (const Case& c : cases)
    {
        EXPECT_EQ(logged([&] { thing_of({c.item}); }), c.messages) << c.item.name;
        const Ref<Test_Thing> made = thing_of({c.item, {"Sint64", {CMPI_sint64, std::int64_t{5}}}});
        EXPECT_EQ(made->Sint64.value, 5);
        made->Sint64.clear();
        for (uint32 i = 0; i < made->meta_class->num_meta_features; ++i)
            EXPECT_TRUE(null_of(static_cast<const Instance*>(made.ptr()), as_property(made->meta_class->meta_features[i])));
    }
}

TEST_F(Conversion, refuses_a_reference_to_a_class_that_does_not_fit)
{
    const auto messages = logged(
        [&] {
            from_path<Test_Link>({{}, {}, "Test_Link", {{"Dependent", reference("Test_Link", {{"Note", string("x")}})}}});
        });
    EXPECT_THAT(messages, testing::Contains("Container: conversion error: Test_Link.Dependent"));
}

TEST_F(Conversion, copes_with_data_that_hold_nothing)
{
    const auto convert = [&](CMPIType type, Value& made) {
        return cmpi_to_cimple_value(&repository, broker.face(), name_space, {type, CMPI_goodValue, {}}, made);
    };
    const auto message = [&](CMPIType type)
    {
        return logged(
            [&]
            {
                Value made;
                convert(type, made);
            });
    };
    Value made;
    EXPECT_EQ(convert(CMPI_string, made), 0);
    EXPECT_EQ(*made.get_if<String>(), "");
    constexpr CMPIType unusable[] = {
        CMPI_dateTime, CMPI_ref,  CMPI_instance, CMPI_uint8 | CMPI_ARRAY, CMPI_ref | CMPI_ARRAY, CMPI_null,
        CMPI_chars,    CMPI_args, 0x7777};
    for (const CMPIType type : unusable)
        EXPECT_EQ(convert(type, made), -1) << type;
    EXPECT_THAT(message(CMPI_dateTime), ElementsAre("Converter: CMGetStringFormat() failed", "Converter: conversion error"));
    EXPECT_THAT(message(CMPI_ref), ElementsAre("Converter: null instance", "Converter: failed to create CIMPLE instance"));
    EXPECT_THAT(message(CMPI_args), ElementsAre("Converter: unknown type"));
    EXPECT_THAT(logged([&] { convert(CMPI_string, made); }, "INFO"), ElementsAre("Converter: ignored null CMPI string"));
}

TEST_F(Conversion, survives_a_server_that_throws_or_answers_nothing)
{
    CMPIInstanceFT instance_table = Instance_Object::table;
    instance_table.getPropertyCount = [](const CMPIInstance*, CMPIStatus*) { return CMPICount{1}; };
    instance_table.release = [](CMPIInstance*) -> CMPIStatus { throw std::runtime_error("release"); };
    CMPIInstance face = {nullptr, &instance_table};
    const auto take = [&] { from_cmpi<Test_Thing>(CMPI_Ptr<CMPIInstance>(&face).get()); };
    instance_table.getPropertyAt = [](const CMPIInstance*, CMPICount, CMPIString**, CMPIStatus*) -> CMPIData { throw 1; };
    EXPECT_THAT(logged(take), ElementsAre("CMPI_Containers: CMGetPropertyAt() threw exception: index=0 size=1",
                                          "Container: get_name() failed: class=Test_Thing, index=0"));
    instance_table.getPropertyAt = [](const CMPIInstance*, CMPICount, CMPIString**, CMPIStatus*) -> CMPIData { return {}; };
    EXPECT_THAT(logged(take), ElementsAre("CMPI_Containers: CMGetPropertyAt() failed",
                                          "Container: get_name() failed: class=Test_Thing, index=0"));

    CMPIObjectPathFT path_table = Path_Object::table;
    path_table.getClassName = [](const CMPIObjectPath*, CMPIStatus*) -> CMPIString* { return nullptr; };
    CMPIObjectPath nameless = {nullptr, &path_table};
    CMPIStringFT string_table = cimserver::String_Object::table;
    string_table.getCharPtr = [](const CMPIString*, CMPIStatus*) -> const char* { return nullptr; };
    CMPIString mute = {nullptr, &string_table};
    Value made;
    const auto convert = [&](CMPIType type, CMPIValue content) {
        return cmpi_to_cimple_value(&repository, broker.face(), name_space, {type, CMPI_goodValue, content}, made);
    };
    EXPECT_THAT(logged([&] { EXPECT_EQ(convert(CMPI_ref, {.ref = &nameless}), -1); }),
                ElementsAre("Converter: CMGetClassName() failed", "Converter: failed to create CIMPLE instance"));
    EXPECT_THAT(logged([&] { EXPECT_EQ(convert(CMPI_string, {.string = &mute}), 0); }),
                ElementsAre("Converter: CMGetCharsPtr() failed"));
    EXPECT_EQ(*made.get_if<String>(), "");
}

TEST_F(Conversion, leaves_no_object_with_the_broker_in_a_long_request)
{
    const Ref<Test_Link> original = make_link("a", "b");
    original->Detail = thing("detail").steal();
    original->Detail->When.set(Datetime(7));
    original->Detail->Uint8s.set({1, 2});
    const auto convert = [&]
    {
        CMPI_Ptr<CMPIObjectPath> object_path;
        CMPI_Ptr<CMPIInstance> made;
        EXPECT_EQ(make_cmpi_object_path(broker.face(), original.ptr(), name_space, object_path), CMPI_RC_OK);
        EXPECT_EQ(make_cmpi_instance(broker.face(), original.ptr(), name_space, object_path.get(), nullptr, made), CMPI_RC_OK);
    };
    convert();
    const std::size_t before = mallinfo2().uordblks;
    for (int i = 0; i < 5'000; ++i)
        convert();
    EXPECT_LT(mallinfo2().uordblks, before + 100'000);
}

TEST_F(Conversion, says_what_cannot_be_sent)
{
    const auto send = [&](const Value& sent, const char* ns)
    {
        CMPI_Data data;
        return _to_cmpi_data(&repository, broker.face(), ns, sent, 0, data);
    };
    EXPECT_THAT(logged([&] { send(Value(), name_space); }), ElementsAre("Converter: missing type"));

    Value no_instance;
    no_instance.set_value(static_cast<Instance*>(nullptr));
    EXPECT_THAT(logged([&] { send(no_instance, name_space); }), ElementsAre("Converter: null instance argument"));
    Value homeless;
    homeless.set_value(static_cast<Instance*>(thing("a").steal()));
    EXPECT_THAT(logged([&] { send(homeless, ""); }), ElementsAre("Converter: null namespace"));
    EXPECT_EQ(send(homeless, name_space), 0);
}

TEST_F(Conversion, fails_as_a_whole_when_the_broker_makes_nothing)
{
    CMPIBrokerEncFT nothing = *broker.face()->eft;
    nothing.newInstance = [](const CMPIBroker*, const CMPIObjectPath*, CMPIStatus*) -> CMPIInstance* { return nullptr; };
    CMPIBroker poor = *broker.face();
    poor.eft = &nothing;
    const Ref<Test_Thing> sent = thing("a");
    CMPI_Ptr<CMPIInstance> made;
    EXPECT_EQ(make_cmpi_instance(&poor, sent.ptr(), name_space, thing_path("a"), nullptr, made), CMPI_RC_ERR_FAILED);

    nothing.newObjectPath = [](const CMPIBroker*, const char*, const char*, CMPIStatus*) -> CMPIObjectPath* { return nullptr; };
    CMPI_Ptr<CMPIObjectPath> no_path;
    EXPECT_EQ(make_cmpi_object_path(&poor, sent.ptr(), name_space, no_path), CMPI_RC_ERR_FAILED);
    EXPECT_THAT(logged([&] { make_cmpi_instance(broker.face(), sent.ptr(), name_space, nullptr, nullptr, made); }),
                ElementsAre("Converter: No ObjectPath built before call to make_CMPI_instance"));

    // A string that cannot be made leaves its property out.
    CMPIBrokerEncFT silent = *broker.face()->eft;
    silent.newString = [](const CMPIBroker*, const char*, CMPIStatus*) -> CMPIString* { return nullptr; };
    poor.eft = &silent;
    EXPECT_THAT(logged([&] { make_cmpi_instance(&poor, sent.ptr(), name_space, thing_path("a"), nullptr, made); }),
                ElementsAre("Converter: CMNewString() failed", "CMPI_Containers: _to_cmpi_data() failed: feature=Name",
                            "Container: conversion error: Test_Thing.Name"));
}

} // namespace
