#include "tests/runtime/sample_classes.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <vector>

using namespace zmlr;
using namespace sample;

namespace
{

struct Query
{
    const char* result_class;
    const char* role;
    const char* result_role;
    int result;
};

TEST(Association, finds_the_far_ends)
{
    const auto near = element("near");
    const auto far = disk("far");
    const auto association = linked(near, far);
    const Query rows[] = {
        {nullptr, nullptr, nullptr, 1},
        {"", "", "", 1},
        {"sample_disk", "antecedent", "dependent", 1},
        {"Sample_Element", nullptr, nullptr, 1},
        {"Sample_Person", nullptr, nullptr, 0},
        {nullptr, "Dependent", nullptr, -1},
        {nullptr, nullptr, "Antecedent", 0},
    };
    for (const Query& row : rows)
    {
        const Instance* out[2] = {};
        EXPECT_EQ(get_associators(near.ptr(), association.ptr(), row.result_class, row.role, row.result_role, out), row.result);
        if (row.result == 1)
        {
            EXPECT_EQ(out[0], far.ptr());
        }
    }
}

TEST(Association, concerns_only_the_objects_it_refers_to)
{
    const auto near = element("near");
    const auto association = linked(near, disk("far"));
    const Instance* out[2] = {};
    EXPECT_EQ(get_associators(element("other").ptr(), association.ptr(), nullptr, nullptr, nullptr, out), -1);
    const Ref<Sample_Person> person(create<Sample_Person>());
    person->Name.set("near");
    EXPECT_EQ(get_associators(person.ptr(), association.ptr(), nullptr, nullptr, nullptr, out), -1) << "unrelated class";
    EXPECT_EQ(get_associators(near.ptr(), linked({}, {}).ptr(), nullptr, nullptr, nullptr, out), -1);

    // An object that both ends refer to is a source twice and never its own far end.
    const auto self = disk("self");
    EXPECT_EQ(get_associators(self.ptr(), linked(Ref<Sample_Element>(clone(self.ptr())), self).ptr(), "", "", "", out), 0);

    EXPECT_TRUE(is_reference_of(near.ptr(), association.ptr(), nullptr));
    EXPECT_TRUE(is_reference_of(near.ptr(), association.ptr(), "ANTECEDENT"));
    EXPECT_FALSE(is_reference_of(near.ptr(), association.ptr(), "Dependent"));
    EXPECT_FALSE(is_reference_of(element("other").ptr(), association.ptr(), ""));
    EXPECT_FALSE(is_reference_of(near.ptr(), linked({}, {}).ptr(), ""));
}

TEST(Name_Space, is_set_depth_first_where_there_is_none)
{
    const auto near = element("near");
    near->__name_space = "root/other";
    const auto association = linked(near, disk("far"));
    const auto third = element("third");
    association->Others.value.append(nullptr);
    association->Others.value.append(Ref<Sample_Element>(third).steal());

    __set_name_space_recursive(association.ptr(), "root/zemlar", false);
    EXPECT_EQ(association->__name_space, "root/zemlar");
    EXPECT_EQ(near->__name_space, "root/other");
    EXPECT_EQ(association->Dependent->__name_space, "root/zemlar");
    EXPECT_EQ(third->__name_space, "root/zemlar");

    __set_name_space_recursive(association.ptr(), "root/new", true);
    EXPECT_EQ(near->__name_space, "root/new");

    std::vector<const Instance*> visited;
    __visit(
        association.ptr(), [](Instance* i, void* data) { static_cast<std::vector<const Instance*>*>(data)->push_back(i); },
        &visited);
    EXPECT_THAT(visited, ::testing::ElementsAre(association.ptr(), near.ptr(), association->Dependent, third.ptr()));
}

} // namespace
