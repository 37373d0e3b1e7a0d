#include "runtime/meta.h"

#include "tests/runtime/sample_classes.h"

#include <gtest/gtest.h>

using namespace zmlr;
using namespace sample;

namespace
{

TEST(Meta, finds_only_what_is_of_the_kind)
{
    EXPECT_EQ(1U << flag_name_to_index("EmbeddedInstance"), uint32{Flag_EmbeddedInstance});
    EXPECT_EQ(flag_name_to_index("Keys"), 0xFFFFFFFF);
    EXPECT_EQ(find_property(&Sample_Disk::static_meta_class, "Reset"), nullptr);
    EXPECT_EQ(find_parameter(&Sample_Element_Reset_method::static_meta_class, "Peer", Flag_Property), nullptr);
    EXPECT_FALSE(has_feature(&Sample_Link::static_meta_class, Flag_Method));
}

TEST(Meta, every_class_descends_from_the_root)
{
    const Meta_Class* const element_class = &Sample_Element::static_meta_class;
    const Meta_Class* const disk_class = &Sample_Disk::static_meta_class;
    EXPECT_TRUE(is_subclass(&Instance::static_meta_class, disk_class));
    EXPECT_TRUE(is_subclass(element_class, disk_class));
    EXPECT_TRUE(is_subclass(disk_class, disk_class));
    EXPECT_FALSE(is_subclass(disk_class, element_class));

    // Another module's copy of the class is the same class.
    const Meta_Class twin = *element_class;
    EXPECT_TRUE(is_subclass(&twin, disk_class));
}

TEST(Meta, only_classes_made_at_run_time_are_counted)
{
    auto* made = new Meta_Class(Sample_Setting::static_meta_class);
    Atomic_create(&made->refs, 1);
    Instance* instance = create(made, true);
    EXPECT_EQ(Atomic_get(&made->refs), 2U);
    unref(made);
    EXPECT_EQ(Atomic_get(&made->refs), 1U);
    unref(instance); // the last one: frees the class too, or a leak is reported

    unref(&Sample_Setting::static_meta_class);
    ref(&Sample_Setting::static_meta_class);
    EXPECT_EQ(Atomic_get(&Sample_Setting::static_meta_class.refs), 0U);
}

} // namespace
