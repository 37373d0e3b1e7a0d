// The meta-data as generic code relies on it, for all classes at once, and by example.
#include "runtime/features.h"
#include "runtime/print.h"
#include "tests/runtime/printed.h"
#include "tests/schema/repository_classes.h"
#include "tests/support/rows.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>

namespace zmlr
{
namespace
{

const Meta_Class& class_named(const char* name)
{
    const Meta_Class* found = find_meta_class(&meta_repository(), name);
    EXPECT_NE(found, nullptr) << name;
    return *found;
}

const Meta_Feature& feature_named(const char* class_name, const char* name)
{
    const Meta_Feature* found = find_feature(&class_named(class_name), name);
    EXPECT_NE(found, nullptr) << class_name << "." << name;
    return *found;
}

template <class Law> void for_each_method(const Meta_Class& meta_class, Law law)
{
    for (const Meta_Feature* feature : features_of(&meta_class))
        if (is_method(feature))
            law(*as_method(feature));
}

void expect_directions_and_return_value(const Meta_Method& method)
{
    const Meta_Feature* last = features_of(&method).back();
    EXPECT_STREQ(last->name, "return_value");
    EXPECT_EQ(as_property(last)->type, method.return_type);
    for (const Meta_Feature* parameter : features_of(&method))
        EXPECT_NE(parameter->flags & (Flag_In | Flag_Out), 0u) << method.name << "." << parameter->name;
}

// An inherited feature is the ancestor's object; an override stands in its place.
TEST(Meta_Data, inherited_features_are_the_ancestors)
{
    for (const Meta_Class* meta_class : repository_classes())
    {
        SCOPED_TRACE(meta_class->name);
        EXPECT_EQ(meta_class->num_keys, std::ranges::count_if(features_of(meta_class), is_key));
        EXPECT_EQ(meta_class->meta_repository, &meta_repository());
        for_each_method(*meta_class, expect_directions_and_return_value);

        const Meta_Class* superclass = meta_class->super_meta_class;
        const uint32 inherited = superclass ? superclass->num_meta_features : 0;
        ASSERT_GE(meta_class->num_meta_features, inherited);
        for (uint32 i = 0; i < meta_class->num_meta_features; i++)
        {
            const Meta_Feature* feature = meta_class->meta_features[i];
            const Meta_Feature* above = i < inherited ? superclass->meta_features[i] : nullptr;
            EXPECT_EQ(meta_class->locals[i].local == 0, feature == above) << feature->name;
            EXPECT_STRCASEEQ(feature->name, above ? above->name : feature->name);
        }
    }
}

// An override stands for itself: without a default of its own the property has none.
TEST(Meta_Data, defaults)
{
    for (const auto& row : rows_of("defaults.txt"))
    {
        const Ref<Instance> made(create(&class_named(row[0].c_str()), true));
        const Meta_Property* property = as_property(&feature_named(row[0].c_str(), row.at(1).c_str()));
        const void* value = address_of(made.ptr(), property->offset);
        const auto print = [&](std::FILE* stream) { print_scalar(stream, static_cast<Type>(property->type), value); };
        EXPECT_EQ(null_of(made.ptr(), property) ? "none" : printed(print), row.at(2)) << row[0] << "." << row[1];
    }
}

TEST(Meta_Data, flag_words)
{
    for (const auto& row : rows_of("flags.txt"))
    {
        const auto dot = row.at(1).find('.');
        const Meta_Feature* feature = &feature_named(row[0].c_str(), row[1].substr(0, dot).c_str());
        if (dot != std::string::npos)
            feature = find_parameter(as_method(feature), row[1].c_str() + dot + 1);
        ASSERT_NE(feature, nullptr) << row[1];
        EXPECT_EQ(feature->flags, std::stoul(row.at(2), nullptr, 16)) << row[0] << "." << row[1];
    }

    const auto* change = as_method(&feature_named("CIM_Service", "ChangeAffectedElementsAssignedSequence"));
    EXPECT_EQ(as_reference(find_parameter(change, "ManagedElements"))->subscript, 1);
    EXPECT_EQ(as_property(find_parameter(change, "AssignedSequence"))->subscript, -1);
}

TEST(Meta_Data, an_overriding_method_replaces_the_parameters)
{
    EXPECT_NE(find_parameter(as_method(&feature_named("CIM_AlarmDevice", "SetAlarmState")), "RequestedAlarmState"), nullptr);
    EXPECT_EQ(find_parameter(as_method(&feature_named("ZEMLAR_AlarmDevice", "SetAlarmState")), "RequestedAlarmState"), nullptr);
}

} // namespace
} // namespace zmlr
