// What instances become on the wire, and what comes back from it.
#include "cimserver/broker/objects.h"
#include "cmpi/cmpi_containers.h"
#include "cmpi/converter.h"
#include "tests/cmpi/served_provider.h"

#include <gmock/gmock.h>

#include <malloc.h>
#include <stdexcept>

using namespace test;
using testing::ElementsAre;
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

// A message, or several, and what brings them about.
struct Complaint
{
    std::vector<std::string> messages;
    std::function<void()> work;
};

class Complaints : public Conversion
{
protected:
    void expect(const std::vector<Complaint>& complaints)
    {
        for (const Complaint& complaint : complaints)
            EXPECT_EQ(logged(complaint.work), complaint.messages);
    }

    // Of any type: all bits zero, which an empty initialiser does not promise for a union.
    static constexpr CMPIValue zeros = {.uint64 = 0};

    // From CMPI: data of a type with this content, taken by itself.
    std::function<void()> taking(CMPIType type, CMPIValue content, int answer = -1)
    {
        return [=, this]
        {
            Value made;
            EXPECT_EQ(cmpi_to_cimple_value(&repository, broker.face(), name_space, {type, CMPI_goodValue, content}, made),
                      answer);
        };
    }
    std::function<void()> taking_array(CMPIType type, std::vector<cimserver::Value> elements, CMPIType declared)
    {
        return [=, this]
        {
            auto& array = make<cimserver::Array_Object>(type, elements);
            taking(static_cast<CMPIType>(declared | CMPI_ARRAY), {.array = array.face()})();
        };
    }

    // To CMPI, with a broker that the test has impaired.
    int send(const Value& value, uint32 flags = 0, const char* ns = name_space)
    {
        CMPI_Data data;
        return _to_cmpi_data(&repository, &server, ns, value, flags, data);
    }
    static Value instance_value(Ref<Test_Thing> instance)
    {
        Value value;
        value.set_value(static_cast<Instance*>(instance.steal()));
        return value;
    }

    Complaints() { server.eft = &objects; }

    CMPIBrokerEncFT objects = *broker.face()->eft;
    CMPIBroker server = *broker.face();
};

CMPIStatus failing() { return {CMPI_RC_ERR_FAILED, nullptr}; }

TEST_F(Complaints, about_scalars_that_the_server_hands_over)
{
    CMPIStringFT string_table = cimserver::String_Object::table;
    string_table.getCharPtr = [](const CMPIString*, CMPIStatus*) -> const char* { return nullptr; };
    CMPIString mute = {nullptr, &string_table};
    CMPIDateTimeFT datetime_table = cimserver::Datetime_Object::table;
    datetime_table.getStringFormat = [](const CMPIDateTime*, CMPIStatus*)
    { return make<cimserver::String_Object>("yesterday").face(); };
    CMPIDateTime vague = {nullptr, &datetime_table};
    expect({
        {{"Converter: unknown type"}, taking(CMPI_args, zeros)},
        {{"Converter: unknown type"}, taking(CMPI_chars, zeros)},
        {{"Converter: unknown type"}, taking(CMPI_null, zeros)},
        {{"Converter: unknown type"}, taking(0x7777, zeros)},
        {{"Converter: CMGetCharsPtr() failed"}, taking(CMPI_string, {.string = &mute}, 0)},
        {{"Converter: CMGetStringFormat() failed", "Converter: conversion error"}, taking(CMPI_dateTime, zeros)},
        {{"Converter: conversion error"}, taking(CMPI_dateTime, {.dateTime = &vague})},
    });
    Value made;
    const CMPIData no_string = {CMPI_string, CMPI_goodValue, zeros};
    EXPECT_THAT(logged([&] { cmpi_to_cimple_value(&repository, broker.face(), name_space, no_string, made); }, "INFO"),
                ElementsAre("Converter: ignored null CMPI string"));
    EXPECT_EQ(*made.get_if<String>(), "");
}

TEST_F(Complaints, about_objects_that_the_server_hands_over)
{
    CMPIObjectPathFT path_table = Path_Object::table;
    path_table.getClassName = [](const CMPIObjectPath*, CMPIStatus*) -> CMPIString* { return nullptr; };
    CMPIObjectPath nameless = {nullptr, &path_table};
    CMPIInstanceFT instance_table = Instance_Object::table;
    instance_table.getObjectPath = [](const CMPIInstance*, CMPIStatus*) -> CMPIObjectPath* { return nullptr; };
    CMPIInstance homeless = {nullptr, &instance_table};
    auto& stranger = make<Instance_Object>(cimserver::Instance{{"", "", "Test_Nobody", {}}, {}});
    const char* failed = "Converter: failed to create CIMPLE instance";
    expect({
        {{"Converter: null instance", failed}, taking(CMPI_ref, zeros)},
        {{"Converter: null instance", failed}, taking(CMPI_instance, zeros)},
        {{"Converter: CMGetClassName() failed", failed}, taking(CMPI_ref, {.ref = &nameless})},
        {{"Converter: CMGetObjectPath() failed", failed}, taking(CMPI_instance, {.inst = &homeless})},
        {{"Converter: failed to find meta class: Test_Nobody", failed}, taking(CMPI_instance, {.inst = stranger.face()})},
    });
}

TEST_F(Complaints, about_arrays_that_the_server_hands_over)
{
    CMPIArrayFT array_table = cimserver::Array_Object::table;
    array_table.getSize = [](const CMPIArray*, CMPIStatus*) { return CMPICount{1}; };
    array_table.getElementAt = [](const CMPIArray*, CMPICount, CMPIStatus*) -> CMPIData {
        return {CMPI_dateTime, CMPI_goodValue, {}};
    };
    CMPIArray timeless = {nullptr, &array_table};
    const cimserver::Value nobody = reference("Test_Nobody", {});
    expect({
        {{"Converter: type mismatch"}, taking_array(CMPI_uint8, {{CMPI_uint8, std::uint64_t{1}}}, CMPI_uint16)},
        {{"Converter: encountered null array element"}, taking_array(CMPI_string, {string("a"), {CMPI_string, {}}}, CMPI_string)},
        {{"Converter: CMGetStringFormat() failed", "Converter: conversion error"},
         taking(CMPI_dateTime | CMPI_ARRAY, {.array = &timeless})},
        {{"Converter: array element type mismatch"}, taking_array(CMPI_string, {string("a")}, CMPI_ref)},
        {{"Converter: encountered null instance element"}, taking_array(CMPI_ref, {{CMPI_ref, {}}}, CMPI_ref)},
        {{"Converter: failed to find meta class: Test_Nobody", "Converter: failed to create CIMPLE instance"},
         taking_array(CMPI_ref, {nobody}, CMPI_ref)},
    });
    taking(CMPI_uint8 | CMPI_ARRAY, zeros)();
    taking(CMPI_ref | CMPI_ARRAY, zeros)();
}

TEST_F(Complaints, about_values_that_cannot_be_sent)
{
    Value strings;
    strings.set_value(Array<String>({"a", "b"}));
    Value nothing;
    nothing.set_value(static_cast<Instance*>(nullptr));
    Meta_Class nameless = Test_Thing::static_meta_class;
    nameless.name = "";
    const auto no_path = [](const CMPIBroker*, const char*, const char*, CMPIStatus*) -> CMPIObjectPath* { return nullptr; };
    const auto no_instance = [](const CMPIBroker*, const CMPIObjectPath*, CMPIStatus*) -> CMPIInstance* { return nullptr; };
    const auto no_array = [](const CMPIBroker*, CMPICount, CMPIType, CMPIStatus*) -> CMPIArray* { return nullptr; };
    const auto no_string = [](const CMPIBroker*, const char*, CMPIStatus*) -> CMPIString* { return nullptr; };
    static CMPIArrayFT read_only = cimserver::Array_Object::table;
    static CMPIArray array = {nullptr, &read_only};
    read_only.release = [](CMPIArray*) { return CMPIStatus{CMPI_RC_OK, nullptr}; };
    read_only.setElementAt = [](CMPIArray*, CMPICount, const CMPIValue*, CMPIType) { return failing(); };
    expect({
        {{"Converter: missing type"}, [&] { send({}); }},
        {{"Converter: null instance argument"}, [&] { send(nothing); }},
        {{"Converter: null namespace"}, [&] { send(instance_value(thing("a")), 0, ""); }},
        {{"Converter: null classname"},
         [&]
         {
             const auto value = instance_value(thing("a"));
             (*value.get_if<Instance*>())->meta_class = &nameless;
             send(value);
             (*value.get_if<Instance*>())->meta_class = &Test_Thing::static_meta_class;
         }},
        {{"Converter: CMNewInstance() failed"},
         [&] { objects.newInstance = no_instance, send(instance_value(thing("a")), Flag_EmbeddedInstance); }},
        {{"Converter: CMNewObjectPath() failed"}, [&] { objects.newObjectPath = no_path, send(instance_value(thing("a"))); }},
        {{"Converter: CMNewString() failed", "Converter: element conversion failed"},
         [&] { objects.newString = no_string, send(strings); }},
        {{"Converter: CMNewArray() failed"}, [&] { objects.newArray = no_array, send(strings); }},
        {{"Converter: CMSetArrayElementAt() failed"},
         [&]
         {
             objects = *broker.face()->eft;
             objects.newArray = [](const CMPIBroker*, CMPICount, CMPIType, CMPIStatus*) { return &array; };
             send(strings);
         }},
    });
    EXPECT_EQ(send(instance_value(thing("a"))), 0);
}

TEST_F(Complaints, about_the_objects_around_the_values)
{
    const Ref<Test_Thing> a = thing("a");
    Ref<Test_Odd> odd(create<Test_Odd>());
    odd->Odd = a.ptr();
    const auto in = [&](auto& container, const Instance* instance, uint32 mask)
    { return [&, instance, mask] { container.convert(instance, mask); }; };

    CMPIInstanceFT instance_table = Instance_Object::table;
    instance_table.getPropertyCount = [](const CMPIInstance*, CMPIStatus*) { return CMPICount{1}; };
    instance_table.setProperty = [](const CMPIInstance*, const char*, const CMPIValue*, CMPIType) { return failing(); };
    CMPIInstance instance = {nullptr, &instance_table};
    CMPIInstance_Container properties(&repository, &server, name_space, &instance);
    const auto take = [&] { from_cmpi<Test_Thing>(&instance); };

    CMPIObjectPathFT path_table = Path_Object::table;
    path_table.getKeyCount = [](const CMPIObjectPath*, CMPIStatus*) { return CMPICount{0}; };
    path_table.addKey = [](CMPIObjectPath*, const char*, const CMPIValue*, CMPIType) { return failing(); };
    CMPIObjectPath object_path = {nullptr, &path_table};
    CMPIObjectPath_Container keys(&repository, &server, name_space, &object_path);

    CMPIArgsFT args_table = cimserver::Args_Object::table;
    args_table.addArg = [](const CMPIArgs*, const char*, const CMPIValue*, CMPIType) { return failing(); };
    CMPIArgs args = {nullptr, &args_table};
    CMPIArgs_Container arguments(&repository, &server, name_space, &args);
    CMPIArgs_Container none(&repository, &server, name_space, nullptr);
    Value value;
    expect({
        {{"Container: ignored null instance arg"}, in(keys, nullptr, 0)},
        {{"Container: unexpected failure: Test_Odd.Odd"}, in(keys, odd.ptr(), 0)},
        {{"CMPI_Containers: CMSetProperty() failed: Name", "Container: conversion error: Test_Thing.Name"},
         in(properties, a.ptr(), 0)},
        {{"CMPI_Containers: CMAddKey() failed", "Container: conversion error: Test_Thing.Name"}, in(keys, a.ptr(), Flag_Key)},
        {{"CMPI_Containers: CMAddArg() failed", "Container: conversion error: Test_Thing.Name"}, in(arguments, a.ptr(), 0)},
        {{}, in(none, a.ptr(), 0)},
        {{"CMPI_Containers: bounds error"}, [&] { properties.get_value(1, Value::STRING, value); }},
        {{"CMPI_Containers: bounds error"}, [&] { keys.get_value(0, Value::STRING, value); }},
        {{"CMPI_Containers: bounds error"}, [&] { none.get_value(0, Value::STRING, value); }},
        {{"CMPI_Containers: CMGetPropertyAt() threw exception: index=0 size=1",
          "Container: get_name() failed: class=Test_Thing, index=0"},
         [&]
         {
             instance_table.getPropertyAt = [](const CMPIInstance*, CMPICount, CMPIString**, CMPIStatus*) -> CMPIData
             { throw 1; };
             take();
         }},
        {{"CMPI_Containers: CMGetPropertyAt() failed", "Container: get_name() failed: class=Test_Thing, index=0"},
         [&]
         {
             instance_table.getPropertyAt = [](const CMPIInstance*, CMPICount, CMPIString**, CMPIStatus*) -> CMPIData
             { return {}; };
             take();
         }},
        {{"Container: unexpected error: Test_Odd.Odd"},
         [&] {
             from_cmpi<Test_Odd>(make<Instance_Object>(cimserver::Instance{{}, {{"Odd", string("x")}}}).face());
         }},
    });
    odd->Odd = nullptr;
}

TEST_F(Complaints, end_a_conversion_when_there_is_no_object_to_fill)
{
    const Ref<Test_Thing> sent = thing("a");
    const char* list[] = {"Uint8", nullptr};
    CMPI_Ptr<CMPIInstance> made;
    CMPI_Ptr<CMPIObjectPath> no_path;
    const auto convert = [&](const CMPIObjectPath* object_path)
    { return make_cmpi_instance(&server, sent.ptr(), name_space, object_path, list, made); };
    const CMPIObjectPath* object_path = thing_path("a");
    EXPECT_THAT(logged([&] { EXPECT_EQ(convert(nullptr), CMPI_RC_OK); }),
                ElementsAre("Converter: No ObjectPath built before call to make_CMPI_instance"));

    static CMPIInstanceFT unfiltered = Instance_Object::table;
    static CMPIInstance instance = {nullptr, &unfiltered};
    unfiltered.release = [](CMPIInstance*) -> CMPIStatus { throw std::runtime_error("release"); };
    unfiltered.setPropertyFilter = [](CMPIInstance*, const char**, const char**) {
        return CMPIStatus{CMPI_RC_ERR_NOT_SUPPORTED, nullptr};
    };
    objects.newInstance = [](const CMPIBroker*, const CMPIObjectPath*, CMPIStatus*) { return &instance; };
    EXPECT_EQ(convert(object_path), CMPI_RC_ERR_NOT_SUPPORTED) << "the filter's own code";

    objects.newInstance = [](const CMPIBroker*, const CMPIObjectPath*, CMPIStatus*) -> CMPIInstance* { return nullptr; };
    EXPECT_EQ(convert(object_path), CMPI_RC_ERR_FAILED);
    objects.newObjectPath = [](const CMPIBroker*, const char*, const char*, CMPIStatus*) -> CMPIObjectPath* { return nullptr; };
    EXPECT_EQ(make_cmpi_object_path(&server, sent.ptr(), name_space, no_path), CMPI_RC_ERR_FAILED);
}

} // namespace
