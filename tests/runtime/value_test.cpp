#include "runtime/features.h"
#include "runtime/value.h"
#include "tests/runtime/printed.h"
#include "tests/runtime/sample_classes.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>

using namespace zmlr;
using namespace sample;

namespace
{

template <class T> void expect_holds(const T& x, sint32 type)
{
    Value value, null_value;
    value.set_value(x);
    EXPECT_EQ(value.type(), type);
    EXPECT_FALSE(value.null());
    T out{};
    EXPECT_EQ(value.get_value(out), 0);
    EXPECT_TRUE(out == x) << type;
    null_value.set_null(static_cast<Value::Type>(type));
    EXPECT_EQ(null_value.type(), type);
    EXPECT_TRUE(null_value.null());
}

template <class... T> void expect_holds_each(const T&... x)
{
    sint32 type = Value::BOOLEAN;
    ((expect_holds(x, type), expect_holds(Array<T>{x}, type + 128), ++type), ...);
}

TEST(Value, holds_every_type)
{
    expect_holds_each(true, uint8{200}, sint8{-3}, uint16{60000}, sint16{-3}, 4000000000U, sint32{-3}, uint64{1} << 63,
                      sint64{-3}, 1.5F, 1.5, char16(65), String("text"), Datetime(5, 60), static_cast<Instance*>(nullptr));

    Value value;
    EXPECT_EQ(value.type(), Value::NONE);
    EXPECT_TRUE(value.null());
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

TEST(Value, carries_references)
{
    const auto target = element("target");
    const auto from = reset_of(target, {Ref<Sample_Element>(target).steal()});
    const auto to = reset_of(element("replaced"), {});
    for (const char* name : {"Peer", "Others"})
    {
        Value value;
        EXPECT_EQ(value.set(from.ptr(), find_reference(&Sample_Element_Reset_method::static_meta_class, name)), 0);
        EXPECT_EQ(value.get(to.ptr(), find_reference(&Sample_Element_Reset_method::static_meta_class, name)), 0);
    }
    EXPECT_EQ(to->Peer, target.ptr());
    EXPECT_TRUE(to->Others.value == Array<Instance*>{target.ptr()});
    EXPECT_EQ(Atomic_get(&target->__refs), 5U);

    const auto half = linked(target, disk("unset"));
    Value unset;
    EXPECT_EQ(unset.set(linked(target, {}).ptr(), find_reference(half->meta_class, "Dependent")), 0);
    EXPECT_EQ(unset.get(half.ptr(), find_reference(half->meta_class, "Dependent")), 0);
    EXPECT_EQ(half->Dependent, nullptr);

    // A value may hold the very instance that it is loaded from.
    Value self;
    self.set_value(static_cast<Instance*>(linked(target, {}).steal()));
    EXPECT_EQ(self.set(*self.get_if<Instance*>(), find_reference(half->meta_class, "Antecedent")), 0);
    EXPECT_EQ(*self.get_if<Instance*>(), target.ptr());
}

TEST(Value, borrows_what_is_only_read)
{
    const auto held = element("held");
    const auto from = reset_of(held, {Ref<Sample_Element>(held).steal()});
    const auto to = reset_of({}, {});
    for (const Meta_Feature* feature : features_of(from.ptr()))
    {
        Value value;
        ASSERT_EQ(value.borrow(from.ptr(), feature), 0);
        EXPECT_EQ(value.type(), type_of(feature));
        const Value copied = value;
        EXPECT_EQ(value.give(to.ptr(), feature), 0) << "a copy: it is not the value's to give";
    }
    EXPECT_TRUE(identical(from.ptr(), to.ptr()));
    EXPECT_EQ(Atomic_get(&held->__refs), 5U);

    Value labels;
    labels.borrow(held.ptr(), property<Sample_Element>("Labels"));
    EXPECT_EQ(labels.get_if<Array<String>>(), &held->Labels.value);
    EXPECT_EQ(labels.borrow(held.ptr(), find_method(held->meta_class, "Reset")), -1);
    labels.set_value(Array<String>{"moved"});
    const String* moved = labels.get_if<Array<String>>()->data();
    EXPECT_EQ(labels.give(held.ptr(), property<Sample_Element>("Labels")), 0);
    EXPECT_EQ(held->Labels.value.data(), moved) << "the very elements";
}

TEST(Value, refuses_what_does_not_fit_and_changes_nothing)
{
    const auto to = linked(element("a"), disk("d"));
    const Sample_Disk* before = to->Dependent;
    Value wrong_class;
    wrong_class.set_value(static_cast<Instance*>(element("no disk").steal()));
    EXPECT_EQ(wrong_class.get(to.ptr(), find_reference(to->meta_class, "Dependent")), -1);
    EXPECT_EQ(to->Dependent, before);

    Value people;
    people.set_value(Array<Instance*>{create<Sample_Person>()});
    const auto reset = reset_of({}, {});
    EXPECT_EQ(people.get(reset.ptr(), find_reference(&Sample_Element_Reset_method::static_meta_class, "Others")), -1);
    EXPECT_TRUE(reset->Others.value.empty());

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
    value.set_value(Array<Instance*>{create<Sample_Disk>(), nullptr});
    EXPECT_THAT(text(),
                ::testing::MatchesRegex("Value\n\\{\n    type=INSTANCE_ARRAY\n    null=false\nSample_Disk\n(.|\n)*NULL\n\\}\n"));
}

} // namespace
