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

Ref<Sample_Element> filled_element()
{
    auto result = element("disk-1");
    result->__name_space = "root/zemlar";
    result->Load.set(0.5);
    result->Samples.set({1.5, 2.5});
    result->Labels.value.append("c");
    return result;
}

TEST(Instance, created_with_defaults_has_them_and_nulls_elsewhere)
{
    const Ref<Sample_Element> made(create<Sample_Element>());
    EXPECT_EQ(set_properties(made.ptr()), "Size Letter Since Caption Labels Codes Intervals");
    EXPECT_TRUE(made->Letter.value == char16(u'x'));
    EXPECT_TRUE(made->Labels.value == (Array<String>{"a", "b"}));
    EXPECT_TRUE(made->Codes.value == (Array<uint16>{2, 3, 5}));
    EXPECT_TRUE(made->Intervals.value == Array<Datetime>{Datetime()});

    const Ref<Sample_Link> unset(create<Sample_Link>());
    EXPECT_EQ(unset->Antecedent, nullptr);
    EXPECT_EQ(unset->Others.null, 1);
}

TEST(Instance, references_are_released_with_their_holder)
{
    const Ref<Sample_Element> target = element("target");
    {
        const Ref<Sample_Link> holder = linked(target, disk("d"));
        ref(target.ptr());
        holder->Others.value.append(target.ptr());
        holder->Others.value.append(nullptr);
        EXPECT_EQ(Atomic_get(&target->__refs), 3U);
        clear(holder.ptr());
        EXPECT_EQ(Atomic_get(&target->__refs), 1U);
        EXPECT_EQ(holder->Others.null, 1);
        holder->Antecedent = Ref<Sample_Element>(target).steal();
    }
    EXPECT_EQ(Atomic_get(&target->__refs), 1U);
}

TEST(Instance, identical_sees_the_differences_that_are_easily_missed)
{
    void (*const changes[])(Sample_Element&) = {
        [](Sample_Element& e) { e.__name_space = "root/other"; },
        [](Sample_Element& e) { e.Slot.value = 9; }, // compared although it is null
        [](Sample_Element& e) { e.Since.set(Datetime(Datetime::DAY, 0)); },
        [](Sample_Element& e) { e.Labels.value.append("d"); },
        [](Sample_Element& e) { e.Codes.value[0] = 7; },
        [](Sample_Element& e) { e.Intervals.value[0] = Datetime(1); },
        [](Sample_Element& e) { e.Load.set(std::numeric_limits<real64>::quiet_NaN()); },
    };
    const Ref<Sample_Element> original = filled_element();
    for (std::size_t i = 0; i < std::size(changes); ++i)
    {
        const Ref<Sample_Element> changed(clone(original.ptr()));
        ASSERT_TRUE(identical(original.ptr(), changed.ptr()));
        changes[i](*changed.ptr());
        EXPECT_FALSE(identical(original.ptr(), changed.ptr())) << i;
    }
    original->Load.set(std::numeric_limits<real64>::quiet_NaN());
    EXPECT_FALSE(identical(original.ptr(), original.ptr())) << "NaN differs from itself";
}

TEST(Instance, keys_are_compared_across_subclasses_and_through_references)
{
    const auto a = element("a");
    EXPECT_TRUE(key_eq(a.ptr(), disk("a").ptr()));
    EXPECT_TRUE(key_eq(disk("a").ptr(), a.ptr()));
    EXPECT_FALSE(key_eq(a.ptr(), disk("b").ptr()));

    const auto first = linked(element("a"), disk("d"));
    EXPECT_TRUE(key_eq(first.ptr(), linked(Ref<Sample_Element>(disk("a").steal()), disk("d")).ptr()));
    EXPECT_FALSE(key_eq(first.ptr(), linked(element("b"), disk("d")).ptr()));
    EXPECT_TRUE(key_eq(linked({}, {}).ptr(), linked({}, {}).ptr()));
    EXPECT_FALSE(key_eq(first.ptr(), a.ptr()));
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
    const Meta_Feature* const features[] = {own[0], &to_person, own[2], own[3]};
    other.meta_features = features;
    EXPECT_FALSE(key_eq(linked({}, {}).ptr(), Ref<Instance>(create(&other, false)).ptr()));
}

TEST(Instance, filter_leaves_what_was_asked_for)
{
    const struct
    {
        std::vector<const char*> names;
        bool keep_keys;
        int result;
        const char* left;
    } rows[] = {
        {{nullptr}, true, 0, "Name"},
        {{nullptr}, false, 0, ""},
        {{"SIZE", "unknown", "Name", "labels", nullptr}, true, 0, "Name Size Labels"},
        {{"Size", "Name", nullptr}, false, 0, "Size"},
        {{"Slot", "Reset", "Size", nullptr}, true, -1, "Name Slot"},
    };
    for (const auto& row : rows)
    {
        const Ref<Sample_Element> filtered = element("a");
        EXPECT_EQ(filter_properties(filtered.ptr(), row.names.data(), row.keep_keys), row.result);
        EXPECT_EQ(set_properties(filtered.ptr()), row.left);
    }
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
    const char* const names[] = {"Dependent", "Others", nullptr};
    EXPECT_EQ(filter_properties(half.ptr(), names, true), 0);
    EXPECT_EQ(half->Dependent, nullptr) << "a key is not touched";
    EXPECT_EQ(half->Others.null, 0);
    __create_refs(half.ptr());
    ASSERT_NE(half->Dependent, nullptr);
    EXPECT_EQ(half->Dependent->Size.value, 1U) << "with defaults";
}

TEST(Name_Space, is_set_depth_first_where_there_is_none)
{
    const auto near = element("near");
    near->__name_space = "root/other";
    const auto association = linked(near, disk("far"));
    const auto third = element("third");
    association->Others.value.append(nullptr);
    association->Others.value.append(Ref<Sample_Element>(third).steal());

    std::vector<const Instance*> visited;
    __visit(
        association.ptr(), [](Instance* i, void* data) { static_cast<std::vector<const Instance*>*>(data)->push_back(i); },
        &visited);
    EXPECT_THAT(visited, ::testing::ElementsAre(association.ptr(), near.ptr(), association->Dependent, third.ptr()));

    __set_name_space_recursive(association.ptr(), "root/zemlar", false);
    for (const Instance* instance : visited)
        EXPECT_EQ(instance->__name_space, instance == near.ptr() ? "root/other" : "root/zemlar");
    __set_name_space_recursive(association.ptr(), "root/new", true);
    for (const Instance* instance : visited)
        EXPECT_EQ(instance->__name_space, "root/new");
}

} // namespace
