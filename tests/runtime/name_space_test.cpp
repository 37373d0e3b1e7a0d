#include "tests/runtime/sample_classes.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <vector>

using namespace zmlr;
using namespace sample;

namespace
{

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
