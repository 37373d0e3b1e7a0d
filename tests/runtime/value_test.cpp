#include "runtime/value.h"

#include "tests/runtime/printed.h"
#include "tests/runtime/sample_classes.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using namespace zmlr;
using namespace sample;

namespace
{

template <class T> void expect_holds(const T& x, Value::Type type, const char* name)
{
    Value value, null_value;
    value.set_value(x);
    EXPECT_EQ(value.type(), type);
    EXPECT_FALSE(value.null());
    EXPECT_STREQ(name_of(type), name);
    EXPECT_STRCASEEQ(_type_name(type), name);

    T out{};
    EXPECT_EQ(value.get_value(out), 0);
    EXPECT_TRUE(out == x) << name;
    null_value.set_null(type);
    EXPECT_EQ(null_value.type(), type);
    EXPECT_TRUE(null_value.null());
}

TEST(Value, holds_every_type)
{
    expect_holds(true, Value::BOOLEAN, "boolean");
    expect_holds(uint8{200}, Value::UINT8, "uint8");
    expect_holds(sint8{-3}, Value::SINT8, "sint8");
    expect_holds(uint16{60000}, Value::UINT16, "uint16");
    expect_holds(sint16{-3}, Value::SINT16, "sint16");
    expect_holds(4000000000U, Value::UINT32, "uint32");
    expect_holds(sint32{-3}, Value::SINT32, "sint32");
    expect_holds(uint64{1} << 63, Value::UINT64, "uint64");
    expect_holds(sint64{-3}, Value::SINT64, "sint64");
    expect_holds(1.5F, Value::REAL32, "real32");
    expect_holds(1.5, Value::REAL64, "real64");
    expect_holds(char16(65), Value::CHAR16, "char16");
    expect_holds(String("text"), Value::STRING, "string");
    expect_holds(Datetime(5, 60), Value::DATETIME, "datetime");
    expect_holds(static_cast<Instance*>(nullptr), Value::INSTANCE, "instance");
    expect_holds(Array<boolean>{true}, Value::BOOLEAN_ARRAY, "boolean_array");
    expect_holds(Array<Datetime>{Datetime(5)}, Value::DATETIME_ARRAY, "datetime_array");
    expect_holds(Array<Instance*>{nullptr}, Value::INSTANCE_ARRAY, "instance_array");

    Value value;
    EXPECT_EQ(value.type(), Value::NONE);
    EXPECT_TRUE(value.null());
    EXPECT_STREQ(_type_name(Value::NONE), "NONE");
    value.set_value("text");
    uint32 other_type = 5;
    EXPECT_EQ(value.get_value(other_type), -1);
    EXPECT_EQ(other_type, 5U);
    value.set_value(*value.get_if<String>());
    EXPECT_EQ(*value.get_if<String>(), "text");
}

TEST(Value, owns_one_reference_to_each_instance)
{
    const auto held = element("held");
    const auto refs = [&held] { return Atomic_get(&held->__refs); };
    {
        Value value;
        value.set_value(Ref<Sample_Element>(held).steal());
        EXPECT_EQ(refs(), 2U);
        Value copied = value;
        EXPECT_EQ(refs(), 3U);
        const Value moved = std::move(copied);
        EXPECT_EQ(refs(), 3U);
        value = moved;
        EXPECT_EQ(refs(), 3U);
        value.set_value(uint32{1});
        EXPECT_EQ(refs(), 2U);
    }
    EXPECT_EQ(refs(), 1U);

    Value array;
    array.set_value(Array<Instance*>{Ref<Sample_Element>(held).steal(), nullptr, Ref<Sample_Element>(held).steal()});
    const Value copied = array;
    EXPECT_EQ(refs(), 5U);
    array.clear();
    EXPECT_EQ(refs(), 3U);
}

TEST(Value, carries_every_property_from_one_instance_to_another)
{
    const auto from = element("a");
    from->Online.set(true);
    from->Slot.set(7);
    from->Delta.set(-5);
    from->Load.set(0.25);
    from->Samples.set({1.0, 2.0});
    from->Caption.clear();
    const Ref<Sample_Element> to(create<Sample_Element>(false));

    for (uint32 i = 0; i < 13; ++i)
    {
        const Meta_Feature* feature = Sample_Element::static_meta_class.meta_features[i];
        Value value;
        EXPECT_EQ(value.set(from.ptr(), feature), 0);
        EXPECT_EQ(value.type(), type_of(feature));
        EXPECT_EQ(value.null(), null_of(from.ptr(), as_property(feature)) != 0);
        EXPECT_EQ(value.get(to.ptr(), feature), 0) << feature->name;
    }
    EXPECT_TRUE(identical(from.ptr(), to.ptr()));

    Value method;
    EXPECT_EQ(method.set(from.ptr(), find_method(from->meta_class, "Reset")), -1);
    EXPECT_EQ(method.type(), Value::NONE);
}

TEST(Value, carries_references)
{
    const auto target = element("target");
    const auto from = linked(target, {});
    from->Others.value.append(Ref<Sample_Element>(target).steal());
    from->Others.null = 0;
    const auto to = linked(element("replaced"), disk("unset"));
    for (const char* name : {"Antecedent", "Dependent", "Others"})
    {
        Value value;
        EXPECT_EQ(value.set(from.ptr(), find_reference(from->meta_class, name)), 0);
        EXPECT_EQ(value.get(to.ptr(), find_reference(to->meta_class, name)), 0);
    }
    EXPECT_EQ(to->Antecedent, target.ptr());
    EXPECT_EQ(to->Dependent, nullptr);
    ASSERT_EQ(to->Others.value.size(), 1U);
    EXPECT_EQ(to->Others.value[0], target.ptr());
    EXPECT_EQ(to->Others.null, 0);
    EXPECT_EQ(Atomic_get(&target->__refs), 5U);

    // A value may hold the very instance that it is loaded from.
    Value self;
    self.set_value(linked(target, {}).steal());
    EXPECT_EQ(self.set(*self.get_if<Instance*>(), find_reference(from->meta_class, "Antecedent")), 0);
    EXPECT_EQ(*self.get_if<Instance*>(), target.ptr());
}

TEST(Value, refuses_what_does_not_fit_and_changes_nothing)
{
    const auto to = linked(element("a"), disk("d"));
    const Sample_Disk* before = to->Dependent;
    Value wrong_class;
    wrong_class.set_value(element("no disk").steal());
    EXPECT_EQ(wrong_class.get(to.ptr(), find_reference(to->meta_class, "Dependent")), -1);
    EXPECT_EQ(to->Dependent, before);

    Value people;
    people.set_value(Array<Instance*>{create<Sample_Person>()});
    EXPECT_EQ(people.get(to.ptr(), find_reference(to->meta_class, "Others")), -1);
    EXPECT_TRUE(to->Others.value.empty());

    const auto e = element("a");
    Value wide;
    wide.set_value(uint64{5});
    EXPECT_EQ(wide.get(e.ptr(), find_property(e->meta_class, "Size")), -1);
    EXPECT_EQ(e->Size.value, 1U);
    EXPECT_EQ(wide.get(nullptr, find_property(e->meta_class, "Size")), -1);
    EXPECT_EQ(Value().get(e.ptr(), find_method(e->meta_class, "Reset")), -1);
}

TEST(Value, prints_what_it_holds)
{
    Value value;
    const auto text = [&value] { return printed([&](std::FILE* stream) { value.fprint(stream); }); };
    EXPECT_EQ(text(), "Value\n{\n    type=NONE\n    null=true\n}\n");
    value.set_value("a\n");
    EXPECT_EQ(text(), "Value\n{\n    type=STRING\n    null=false\n    \"a\\n\"\n}\n");
    value.set_value(Array<uint32>{1, 2});
    value.null(true);
    EXPECT_EQ(text(), "Value\n{\n    type=UINT32_ARRAY\n    null=true\n    { 1, 2 }\n}\n");
    value.set_value(Array<Instance*>{create<Sample_Disk>(), nullptr});
    EXPECT_THAT(text(),
                ::testing::MatchesRegex("Value\n\\{\n    type=INSTANCE_ARRAY\n    null=false\nSample_Disk\n(.|\n)*NULL\n\\}\n"));
}

} // namespace
