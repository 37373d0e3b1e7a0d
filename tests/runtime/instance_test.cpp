#include "runtime/features.h"
#include "tests/runtime/sample_classes.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <limits>
#include <string>
#include <vector>

using namespace zmlr;
using namespace sample;

namespace
{

// The names of the properties that are non-null, in their order.
std::string set_properties(const Instance* instance)
{
    std::string result;
    for (const Meta_Feature* feature : features_of(instance))
        if (is_property(feature) && !null_of(instance, as_property(feature)))
            result += std::string(result.empty() ? "" : " ") + feature->name;
    return result;
}

TEST(Instance, created_with_defaults_has_them_and_nulls_elsewhere)
{
    const Ref<Sample_Element> made(create<Sample_Element>());
    EXPECT_EQ(set_properties(made.ptr()), "Size Since Caption Labels Codes Intervals");
    EXPECT_TRUE(made->Labels.value == (Array<String>{"a", "b"}));
    EXPECT_TRUE(made->Codes.value == (Array<uint16>{2, 3, 5}));
    EXPECT_TRUE(made->Intervals.value == Array<Datetime>{Datetime()});
    EXPECT_EQ(Ref<Sample_Link>(create<Sample_Link>())->Antecedent, nullptr);
}

TEST(Instance, defaults_are_what_the_class_says_to_the_last_bit)
{
    const Ref<Sample_Limits> made(create<Sample_Limits>());
    EXPECT_EQ(made->Text.value, "a\"b\\c\n?\?/ caf\xC3\xA9");
    EXPECT_EQ(made->Largest.value, std::numeric_limits<uint64>::max());
    EXPECT_EQ(made->Smallest.value, std::numeric_limits<sint64>::min());
    EXPECT_EQ(made->Real.value, 1.5F);
    EXPECT_EQ(made->No.null, 0);
    EXPECT_TRUE(made->Ends.value == (Array<uint16>{1, 65535}));
}

TEST(Instance, references_are_released_with_their_holder)
{
    const Ref<Sample_Element> target = element("target");
    {
        const auto holder = reset_of(target, {Ref<Sample_Element>(target).steal(), nullptr});
        EXPECT_EQ(Atomic_get(&target->__refs), 3U);
        clear(holder.ptr());
        EXPECT_EQ(Atomic_get(&target->__refs), 1U);
        EXPECT_EQ(holder->Others.null, 1);
        holder->Peer = Ref<Sample_Element>(target).steal();
    }
    EXPECT_EQ(Atomic_get(&target->__refs), 1U);
}

// Of every class it is seen elsewhere that a clone is identical until anything changes, and that keys decide.
TEST(Instance, a_number_that_is_none_differs_from_itself_and_a_name_space_counts)
{
    const auto original = element("disk-1");
    const Ref<Sample_Element> changed(clone(original.ptr()));
    changed->__name_space = "root/other";
    EXPECT_FALSE(identical(original.ptr(), changed.ptr()));
    original->Load.set(std::numeric_limits<real64>::quiet_NaN());
    EXPECT_FALSE(identical(original.ptr(), original.ptr()));
}

TEST(Instance, keys_of_another_kind_are_never_equal)
{
    const Ref<Sample_Person> person(create<Sample_Person>(false));
    void (*const changes[])(Meta_Property&) = {
        [](Meta_Property& p) { p.flags &= ~uint32{Flag_Key}; },
        [](Meta_Property& p) { p.type = UINT64; },
        [](Meta_Property& p) { p.subscript = -1; },
        [](Meta_Property& p) { p.name = "Title"; },
    };
    for (const auto& change : changes)
    {
        Meta_Property changed = *property<Sample_Person>("Name");
        change(changed);
        Meta_Class other = Sample_Person::static_meta_class;
        const Meta_Feature* const features[] = {&changed};
        other.meta_features = features;
        EXPECT_FALSE(key_eq(person.ptr(), Ref<Instance>(create(&other, false)).ptr()));
    }

    // References to unrelated classes differ even while both are unset.
    Meta_Reference to_person = *find_reference(&Sample_Link::static_meta_class, "Dependent");
    to_person.meta_class = &Sample_Person::static_meta_class;
    Meta_Class other = Sample_Link::static_meta_class;
    const Meta_Feature* const* own = other.meta_features;
    const Meta_Feature* const features[] = {own[0], &to_person, own[2]};
    other.meta_features = features;
    EXPECT_FALSE(key_eq(linked({}, {}).ptr(), Ref<Instance>(create(&other, false)).ptr()));
}

TEST(Instance, filter_leaves_what_was_asked_for)
{
    const auto left = [](std::vector<const char*> names, bool keep_keys, int result)
    {
        const Ref<Sample_Element> filtered = element("a");
        EXPECT_EQ(filter_properties(filtered.ptr(), names.data(), keep_keys), result);
        return set_properties(filtered.ptr());
    };
    EXPECT_EQ(left({nullptr}, false, 0), "");
    EXPECT_EQ(left({"SIZE", "unknown", "labels", nullptr}, true, 0), "Name Size Labels");
    EXPECT_EQ(left({"Slot", "Reset", "Size", nullptr}, true, -1), "Name Slot");
}

TEST(Instance, a_filter_makes_the_references_that_were_asked_for)
{
    const Ref<Instance> record(create(&Sample_Element_Reset_method::static_meta_class));
    Sample_Element* const& made = static_cast<Sample_Element_Reset_method*>(record.ptr())->Peer;
    const char* const peer[] = {"peer", nullptr};
    EXPECT_EQ(filter_properties(record.ptr(), peer, true), 0);
    ASSERT_NE(made, nullptr);
    EXPECT_EQ(made->Size.value, 0U) << "without defaults";
    const Instance* const first = made;
    EXPECT_EQ(filter_properties(record.ptr(), peer, true), 0);
    EXPECT_EQ(made, first);

    const auto half = linked(element("a"), {});
    const char* const names[] = {"Dependent", nullptr};
    EXPECT_EQ(filter_properties(half.ptr(), names, true), 0);
    EXPECT_EQ(half->Dependent, nullptr) << "a key is not touched";
    __create_refs(half.ptr());
    ASSERT_NE(half->Dependent, nullptr);
    EXPECT_EQ(half->Dependent->Size.value, 1U) << "with defaults";
}

TEST(Name_Space, is_set_depth_first_where_there_is_none)
{
    const auto near = element("near");
    near->__name_space = "root/other";
    Instance* const third = linked(element("far"), {}).steal();
    const auto record = reset_of(near, {nullptr, third});

    std::vector<const Instance*> visited;
    __visit(
        record.ptr(), [](Instance* i, void* data) { static_cast<std::vector<const Instance*>*>(data)->push_back(i); }, &visited);
    const Instance* const far = static_cast<Sample_Link*>(third)->Antecedent;
    EXPECT_THAT(visited, ::testing::ElementsAre(record.ptr(), near.ptr(), third, far));

    __set_name_space_recursive(record.ptr(), "root/zemlar", false);
    for (const Instance* instance : visited)
        EXPECT_EQ(instance->__name_space, instance == near.ptr() ? "root/other" : "root/zemlar");
    __set_name_space_recursive(record.ptr(), "root/new", true);
    for (const Instance* instance : visited)
        EXPECT_EQ(instance->__name_space, "root/new");
}

} // namespace
