// What instances become on the wire, and what comes back from it.
#include "cimserver/broker/objects.h"
#include "cmpi/cmpi_containers.h"
#include "cmpi/converter.h"
#include "tests/cmpi/served_provider.h"

#include <gmock/gmock.h>

#include <malloc.h>
#include <stdexcept>

using namespace test;
using cimserver::Array_Object;
using cimserver::Instance_Object;
using cimserver::make;
using cimserver::Named_Value;
using cimserver::Path_Object;
using testing::ElementsAre;
using testing::IsEmpty;
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
        EXPECT_EQ(make_cmpi_instance(broker.face(), instance, name_space, nullptr, nullptr, made), CMPI_RC_OK);
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

TEST_F(Conversion, carries_every_type_there_and_back)
{
    const Ref<Test_Thing> full = full_thing("full");
    const Ref<Test_Thing> sparse = thing("sparse"); // null but for its key and an empty array
    sparse->Strings.set({});
    for (const auto& original : {full, sparse})
    {
        original->__name_space = name_space;
        const Ref<Test_Thing> back = from_cmpi<Test_Thing>(to_cmpi(original.ptr()).get());
        EXPECT_TRUE(identical(original.ptr(), back.ptr())) << original->Name.value.c_str();
    }
}

TEST_F(Conversion, gives_every_type_its_code_and_bits)
{
    const auto sent = to_cmpi(full_thing("full").ptr());
    const auto properties = cimserver::object<Instance_Object>(sent.get()).model().properties;
    std::vector<int> types;
    for (const auto& property : properties)
        types.push_back(property.value.type);
    EXPECT_THAT(types, ElementsAre(0x1600, 0x2, 0x80, 0xC0, 0x90, 0xD0, 0xA0, 0xE0, 0xB0, 0xF0, 0x8, 0xC, 0x3, 0x1800, // scalars
                                   0x2002, 0x2080, 0x20F0, 0x2003, 0x3600, 0x3800));
    EXPECT_EQ(content<std::uint64_t>(properties, "Uint64"), 0xFFFFFFFFFFFFFFFF);
    EXPECT_EQ(content<std::int64_t>(properties, "Sint8"), -128);
    EXPECT_EQ(content<std::uint64_t>(properties, "Char16"), 0x20ACU);
    EXPECT_EQ(std::get<std::string>(content<Values>(properties, "Strings").at(2).content), "zw\xC3\xB6lf");
}

// Both ways through the interface of a provider.
TEST_F(Conversion, tells_references_from_embedded_objects)
{
    const Ref<Test_Link> original = make_link("a", "b");
    original->Dependent->__name_space = "root/other";
    original->Detail = full_thing("detail").steal();
    for (Property<Array<Instance*>>* array : {&original->Others, &original->Details})
    {
        array->null = 0;
        array->value.append(full_thing("element").steal());
    }
    script.instances.emplace_back(original.ptr());
    ref(original.ptr());
    script.create_instance = CREATE_INSTANCE_OK;
    Recorded_Result result;
    CMPIInstanceMI* mi = links();
    const CMPIObjectPath* object_path = path("Test_Link");

    EXPECT_EQ(CMPI_Adapter::enumInstances(mi, request.context(), result.face(), object_path, nullptr).rc, CMPI_RC_OK);
    const auto& properties = result.instances.at(0).properties;
    EXPECT_EQ(value(properties, "Antecedent").type, CMPI_ref);
    EXPECT_EQ(value(properties, "Detail").type, CMPI_instance);
    EXPECT_EQ(value(properties, "Others").type, CMPI_ref | CMPI_ARRAY);
    EXPECT_EQ(value(properties, "Details").type, CMPI_instance | CMPI_ARRAY);
    EXPECT_EQ(path_in(properties, "Dependent").name_space, "root/other");
    EXPECT_EQ(name_in(path_in(properties, "Dependent")), "b");
    const auto& detail = *content<std::shared_ptr<const cimserver::Instance>>(properties, "Detail");
    EXPECT_EQ(text(detail.properties, "When"), "00000000013000.000007:000");

    const CMPIInstance* sent_back = make<Instance_Object>(result.instances[0]).face();
    EXPECT_EQ(CMPI_Adapter::createInstance(mi, request.context(), result.face(), object_path, sent_back).rc, CMPI_RC_OK);
    const auto& back = *cast<Test_Link>(script.instance.ptr());
    ASSERT_TRUE(back.Detail);
    EXPECT_TRUE(key_eq(&back, original.ptr()));
    EXPECT_EQ(back.Detail->Uint8.value, 0xFF);
    ASSERT_EQ(back.Others.value.size(), 1U);
    EXPECT_TRUE(cast<Test_Thing>(back.Others.value[0])->Uint8.null) << "a reference holds keys only";
    ASSERT_EQ(back.Details.value.size(), 1U);
    EXPECT_FALSE(cast<Test_Thing>(back.Details.value[0])->Uint8.null);
    EXPECT_EQ(back.Details.value[0]->__name_space, name_space);
}

TEST_F(Conversion, takes_references_out_of_a_path)
{
    const auto key = reference("test_disk", "b");
    Ref<Instance> made;
    cimserver::Object_Path link = {{}, name_space, "Test_Link", {{"Dependent", key}, {"Note", key}, {"Unknown", key}}};
    EXPECT_EQ(make_cimple_reference(broker.face(), &Test_Link::static_meta_class, make<Path_Object>(link).face(), made),
              CMPI_RC_OK);
    const auto& taken = *cast<Test_Link>(made.ptr());
    EXPECT_FALSE(taken.Antecedent);
    EXPECT_TRUE(taken.Note.null) << "no key";
    ASSERT_TRUE(taken.Dependent);
    EXPECT_EQ(taken.Dependent->meta_class, &Test_Disk::static_meta_class);
    EXPECT_EQ(taken.Dependent->Name.value, "b");
    EXPECT_TRUE(taken.Dependent->Uint8.null);
    EXPECT_EQ(taken.__name_space, name_space);
    EXPECT_EQ(taken.Dependent->__name_space, name_space);
}

TEST_F(Conversion, leaves_bad_items_null_and_says_why)
{
    const std::string at_name = "Container: conversion error: Test_Thing.Name";
    const std::string not_taken = "CMPI_Containers: cmpi_to_cimple_value() failed";
    const struct
    {
        Named_Value item;
        std::vector<std::string> messages;
    } cases[] = {
        {{"Unknown", string("x")}, {"Container: unknown feature: Test_Thing.Unknown"}},
        {{"Uint16", {CMPI_uint32, std::uint64_t{1}}},
         {"CMPI_Containers: type mismatch on Uint16: uint16/uint32", "Container: conversion error: Test_Thing.Uint16"}},
        {{"uint8s", {CMPI_uint8, std::uint64_t{1}}},
         {"CMPI_Containers: type mismatch on uint8s: uint8_array/uint8", "Container: conversion error: Test_Thing.uint8s"}},
        {{"Uint8", {CMPI_uint8, {}}}, {}},
        {{"Uint8s", {CMPI_uint8 | CMPI_ARRAY, {}}}, {}},
        {{"Name", reference("Test_Thing", "x")}, {"CMPI_Containers: type mismatch on Name: string/instance", at_name}},
        {{"Name", reference("Test_Nobody", "x")},
         {"Converter: failed to find meta class: Test_Nobody", "Converter: failed to create CIMPLE instance", not_taken,
          at_name}},
        {{"Strings", {CMPI_string | CMPI_ARRAY, Values{string("a"), {CMPI_string, {}}}}},
         {"Converter: encountered null array element", not_taken, "Container: conversion error: Test_Thing.Strings"}},
    };
    for (const auto& c : cases)
    {
        Ref<Test_Thing> made;
        const auto convert = [&] { made = instance_of<Test_Thing>({c.item, {"Sint64", {CMPI_sint64, std::int64_t{5}}}}); };
        EXPECT_EQ(logged(convert), c.messages) << c.item.name;
        EXPECT_THAT(non_null_of(made.ptr()), ElementsAre("Sint64"));
    }
}

TEST_F(Conversion, leaves_no_object_with_the_broker_in_a_long_request)
{
    const Ref<Test_Link> original = make_link("a", "b");
    original->Detail = full_thing("detail").steal();
    const auto convert = [&](int times)
    {
        for (int i = 0; i < times; ++i)
            to_cmpi(original.ptr());
    };
    convert(10);
    const std::size_t before = mallinfo2().uordblks;
    convert(2'000);
    EXPECT_LT(mallinfo2().uordblks, before + 50'000);
}

// ---- what is logged ----

// A handle of the broker's kind with a table of its own, to be impaired.
template <class Object> struct Impaired
{
    typename Object::Table table = Object::table;
    typename Object::Face face = {nullptr, &table};
};

// Functions of such tables, for any arguments.
template <class T> constexpr auto nothing = [](auto...) -> T { return {}; };
constexpr auto failing = [](auto...) { return CMPIStatus{CMPI_RC_ERR_FAILED, nullptr}; };
constexpr auto one = [](auto...) { return CMPICount{1}; };

// Messages, and what brings them about.
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
    std::function<void()> taking(CMPIType type, CMPIValue data = zeros, int answer = -1)
    {
        return [=, this]
        {
            Value made;
            EXPECT_EQ(cmpi_to_cimple_value(&repository, broker.face(), name_space, {type, CMPI_goodValue, data}, made), answer);
        };
    }
    std::function<void()> taking_array(CMPIType declared, CMPIType type, const Values& elements)
    {
        return taking(declared | CMPI_ARRAY, {.array = make<Array_Object>(type, elements).face()});
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

TEST_F(Complaints, about_values_that_the_server_hands_over)
{
    Impaired<cimserver::String_Object> mute;
    mute.table.getCharPtr = nothing<const char*>;
    Impaired<cimserver::Datetime_Object> vague;
    vague.table.getStringFormat = [](auto...) { return make<cimserver::String_Object>("yesterday").face(); };
    Impaired<Path_Object> nameless;
    nameless.table.getClassName = nothing<CMPIString*>;
    Impaired<Instance_Object> homeless;
    homeless.table.getObjectPath = nothing<CMPIObjectPath*>;
    Impaired<Array_Object> timeless;
    timeless.table.getSize = one;
    timeless.table.getElementAt = [](auto...) { return CMPIData{CMPI_dateTime, CMPI_goodValue, zeros}; };
    CMPIInstance* stranger = make<Instance_Object>(cimserver::Instance{{"", "", "Test_Nobody", {}}, {}}).face();
    const char* not_made = "Converter: failed to create CIMPLE instance";
    const char* unknown = "Converter: failed to find meta class: Test_Nobody";
    expect({
        {{"Converter: unknown type"}, taking(CMPI_args)},
        {{"Converter: unknown type"}, taking(CMPI_chars)},
        {{"Converter: unknown type"}, taking(CMPI_null)},
        {{"Converter: CMGetCharsPtr() failed"}, taking(CMPI_string, {.string = &mute.face}, 0)},
        {{"Converter: CMGetStringFormat() failed", "Converter: conversion error"}, taking(CMPI_dateTime)},
        {{"Converter: conversion error"}, taking(CMPI_dateTime, {.dateTime = &vague.face})},
        {{"Converter: null instance", not_made}, taking(CMPI_ref)},
        {{"Converter: null instance", not_made}, taking(CMPI_instance)},
        {{"Converter: CMGetClassName() failed", not_made}, taking(CMPI_ref, {.ref = &nameless.face})},
        {{"Converter: CMGetObjectPath() failed", not_made}, taking(CMPI_instance, {.inst = &homeless.face})},
        {{unknown, not_made}, taking(CMPI_instance, {.inst = stranger})},
        {{"Converter: null array"}, taking(CMPI_uint8 | CMPI_ARRAY)},
        {{"Converter: null array"}, taking(CMPI_ref | CMPI_ARRAY)},
        {{"Converter: type mismatch"}, taking_array(CMPI_uint16, CMPI_uint8, {{CMPI_uint8, std::uint64_t{1}}})},
        {{"Converter: CMGetStringFormat() failed", "Converter: conversion error"},
         taking(CMPI_dateTime | CMPI_ARRAY, {.array = &timeless.face})},
        {{"Converter: array element type mismatch"}, taking_array(CMPI_ref, CMPI_string, {string("a")})},
        {{"Converter: encountered null instance element"}, taking_array(CMPI_ref, CMPI_ref, {{CMPI_ref, {}}})},
        {{unknown, not_made}, taking_array(CMPI_ref, CMPI_ref, {reference("Test_Nobody", "x")})},
    });
    Value made;
    const CMPIData no_string = {CMPI_string, CMPI_goodValue, zeros};
    EXPECT_THAT(logged([&] { cmpi_to_cimple_value(&repository, broker.face(), name_space, no_string, made); }, "INFO"),
                ElementsAre("Converter: ignored null CMPI string"));
    EXPECT_EQ(*made.get_if<String>(), "");
}

TEST_F(Complaints, about_values_that_cannot_be_sent)
{
    Value strings;
    strings.set_value(Array<String>({"a", "b"}));
    const Value a = instance_value(thing("a"));
    Meta_Class nameless = Test_Thing::static_meta_class;
    nameless.name = "";
    const auto of_class = [&](const Meta_Class& meta_class) { (*a.get_if<Instance*>())->meta_class = &meta_class; };
    static Impaired<Array_Object> read_only;
    read_only.table.release = nothing<CMPIStatus>;
    read_only.table.setElementAt = failing;
    expect({
        {{"Converter: missing type"}, [&] { send({}); }},
        {{"Converter: null instance argument"}, [&] { send(instance_value({})); }},
        {{"Converter: null namespace"}, [&] { send(a, 0, ""); }},
        {{"Converter: null classname"}, [&] { of_class(nameless), send(a), of_class(Test_Thing::static_meta_class); }},
        {{"Converter: CMNewInstance() failed"},
         [&] { objects.newInstance = nothing<CMPIInstance*>, send(a, Flag_EmbeddedInstance); }},
        {{"Converter: CMNewObjectPath() failed"}, [&] { objects.newObjectPath = nothing<CMPIObjectPath*>, send(a); }},
        {{"Converter: CMSetArrayElementAt() failed"},
         [&] { objects.newArray = [](auto...) { return &read_only.face; }, send(strings); }},
        {{"Converter: CMNewString() failed", "Converter: element conversion failed"},
         [&] { objects.newString = nothing<CMPIString*>, send(strings); }},
        {{"Converter: CMNewArray() failed"}, [&] { objects.newArray = nothing<CMPIArray*>, send(strings); }},
    });
}

TEST_F(Complaints, about_the_objects_around_the_values)
{
    const Ref<Test_Thing> a = thing("a");
    const Ref<Test_Odd> odd(create<Test_Odd>());
    odd->Odd = a.ptr();
    Value value;
    const auto fill = [](Container& container, const Instance* instance, uint32 mask = 0)
    { return [&container, instance, mask] { container.convert(instance, mask); }; };
    const auto read = [&](Container& container, uint32 index)
    { return [&, index] { EXPECT_EQ(container.get_value(index, Value::STRING, value), -1); }; };

    Impaired<Instance_Object> instance;
    instance.table.getPropertyCount = one;
    instance.table.setProperty = failing;
    CMPIInstance_Container properties(&repository, &server, name_space, &instance.face);
    Impaired<Path_Object> object_path;
    object_path.table.getKeyCount = one;
    object_path.table.getKeyAt = nothing<CMPIData>;
    object_path.table.addKey = failing;
    CMPIObjectPath_Container keys(&repository, &server, name_space, &object_path.face);
    Impaired<cimserver::Args_Object> args;
    args.table.addArg = failing;
    CMPIArgs_Container arguments(&repository, &server, name_space, &args.face);
    CMPIArgs_Container none(&repository, &server, name_space, nullptr);

    const char* at_name = "Container: conversion error: Test_Thing.Name";
    const char* no_name = "Container: get_name() failed: class=Test_Thing, index=0";
    const auto take = [&](auto get_property_at)
    { return [&, get_property_at] { instance.table.getPropertyAt = get_property_at, from_cmpi<Test_Thing>(&instance.face); }; };
    expect({
        {{"Container: ignored null instance arg"}, fill(keys, nullptr)},
        {{"Container: unexpected failure: Test_Odd.Odd"}, fill(keys, odd.ptr())},
        {{"CMPI_Containers: CMSetProperty() failed: Name", at_name}, fill(properties, a.ptr())},
        {{"CMPI_Containers: CMAddKey() failed", at_name}, fill(keys, a.ptr(), Flag_Key)},
        {{"CMPI_Containers: CMAddArg() failed", at_name}, fill(arguments, a.ptr())},
        {{}, fill(none, a.ptr())},
        {{"CMPI_Containers: bounds error"}, read(properties, 1)},
        {{"CMPI_Containers: bounds error"}, read(keys, 1)},
        {{"CMPI_Containers: bounds error"}, read(none, 0)},
        {{"CMPI_Containers: CMGetKeyAt() failed"}, read(keys, 0)},
        {{"CMPI_Containers: CMGetPropertyAt() threw exception: index=0 size=1", no_name},
         take([](auto...) -> CMPIData { throw 1; })},
        {{"CMPI_Containers: CMGetPropertyAt() failed", no_name}, take(nothing<CMPIData>)},
        {{"Container: unexpected error: Test_Odd.Odd"},
         [&] {
             instance_of<Test_Odd>({{"Odd", string("x")}});
         }},
    });
    objects.newString = nothing<CMPIString*>;
    EXPECT_THAT(logged(fill(arguments, a.ptr())),
                ElementsAre("Converter: CMNewString() failed", "CMPI_Containers: _to_cmpi_data() failed: feature=Name", at_name));
    odd->Odd = nullptr;
}

TEST_F(Complaints, end_a_conversion_when_there_is_no_object_to_fill)
{
    const Ref<Test_Thing> sent = thing("a");
    const char* list[] = {"Uint8", nullptr};
    CMPI_Ptr<CMPIInstance> made;
    CMPI_Ptr<CMPIObjectPath> no_path;
    const CMPIObjectPath* object_path = thing_path("a");
    const auto convert = [&] { return make_cmpi_instance(&server, sent.ptr(), name_space, object_path, list, made); };
    EXPECT_THAT(logged([&] { EXPECT_EQ(convert(), CMPI_RC_OK); }), IsEmpty());

    static Impaired<Instance_Object> unfiltered;
    unfiltered.table.release = [](auto...) -> CMPIStatus { throw std::runtime_error("release"); };
    unfiltered.table.setPropertyFilter = [](auto...) { return CMPIStatus{CMPI_RC_ERR_NOT_SUPPORTED, nullptr}; };
    objects.newInstance = [](auto...) { return &unfiltered.face; };
    EXPECT_EQ(convert(), CMPI_RC_ERR_NOT_SUPPORTED) << "the filter's own code";

    objects.newInstance = nothing<CMPIInstance*>;
    EXPECT_EQ(convert(), CMPI_RC_ERR_FAILED);
    objects.newObjectPath = nothing<CMPIObjectPath*>;
    EXPECT_EQ(make_cmpi_object_path(&server, sent.ptr(), name_space, no_path), CMPI_RC_ERR_FAILED);
}

} // namespace
