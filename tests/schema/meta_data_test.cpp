// The meta-data as generic code relies on it, for all classes at once, and by example.
#include "runtime/instance.h"
#include "runtime/name_index.h"
#include "runtime/print.h"
#include "schema/CIM_DiagnosticService.h"
#include "schema/CIM_Service.h"
#include "schema/ZEMLAR_AlarmDevice.h"
#include "schema/repository.h"
#include "tests/runtime/printed.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <span>
#include <string>

namespace zmlr
{
namespace
{

std::span<const Meta_Class* const> all_classes() { return {meta_repository().meta_classes, meta_repository().num_meta_classes}; }

std::span<const Meta_Feature* const> features_of(const Meta_Record& record)
{
    return {record.meta_features, record.num_meta_features};
}

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

uint32 offset_of(const Meta_Feature* feature)
{
    return is_property(feature) ? as_property(feature)->offset : as_reference(feature)->offset;
}

// Bytes from the offset to the end of the value and its null flag.
uint32 extent_of(const Meta_Feature* feature)
{
    if (is_property(feature))
        return type_size_of(as_property(feature)) + 1;
    return as_reference(feature)->subscript ? static_cast<uint32>(sizeof(void*)) + 1 : static_cast<uint32>(sizeof(void*));
}

// Fields lie behind the head, in feature order, apart from each other and inside the record.
void expect_fields_apart(const Meta_Record& record)
{
    uint32 end = sizeof(Instance);
    for (const Meta_Feature* feature : features_of(record))
    {
        if (is_method(feature))
            continue;
        EXPECT_GE(offset_of(feature), end) << record.name << "." << feature->name;
        end = offset_of(feature) + extent_of(feature);
    }
    EXPECT_LE(end, record.size) << record.name;
}

template <class Law> void for_each_method(const Meta_Class& meta_class, Law law)
{
    for (const Meta_Feature* feature : features_of(meta_class))
        if (is_method(feature))
            law(*as_method(feature));
}

void expect_return_value_last(const Meta_Method& method)
{
    SCOPED_TRACE(method.name);
    const Meta_Feature* last = features_of(method).back();
    EXPECT_STREQ(last->name, "return_value");
    EXPECT_EQ(last->flags, 0x01000001u);
    EXPECT_EQ(as_property(last)->type, method.return_type);
    for (const Meta_Feature* parameter : features_of(method))
        EXPECT_NE(parameter->flags & (Flag_In | Flag_Out), 0u) << parameter->name;
}

TEST(Meta_Data, fields_lie_apart_keys_are_counted_and_methods_return)
{
    for (const Meta_Class* meta_class : all_classes())
    {
        SCOPED_TRACE(meta_class->name);
        expect_fields_apart(*meta_class);
        EXPECT_EQ(meta_class->num_keys, std::ranges::count_if(features_of(*meta_class), is_key));
        EXPECT_EQ(meta_class->meta_repository, &meta_repository());
        for_each_method(*meta_class, expect_fields_apart);
        for_each_method(*meta_class, expect_return_value_last);
    }
}

// An inherited feature is the ancestor's object; an override stands in its place, remains a key, and may narrow a reference.
TEST(Meta_Data, inherited_features_are_the_ancestors)
{
    for (const Meta_Class* meta_class : all_classes())
    {
        const Meta_Class* superclass = meta_class->super_meta_class;
        const uint32 inherited = superclass ? superclass->num_meta_features : 0;
        ASSERT_GE(meta_class->num_meta_features, inherited) << meta_class->name;
        for (uint32 i = 0; i < meta_class->num_meta_features; i++)
        {
            const Meta_Feature* feature = meta_class->meta_features[i];
            const Meta_Feature* above = i < inherited ? superclass->meta_features[i] : nullptr;
            SCOPED_TRACE(std::string(meta_class->name) + "." + feature->name);
            EXPECT_EQ(meta_class->locals[i].local == 0, feature == above);
            if (!above)
                continue;
            EXPECT_STRCASEEQ(feature->name, above->name);
            EXPECT_TRUE(is_key(feature) || !is_key(above));
            EXPECT_TRUE(!is_reference(feature) ||
                        is_subclass(as_reference(above)->meta_class, as_reference(feature)->meta_class));
        }
    }
}

// An override stands for itself: without a default of its own the property has none.
TEST(Meta_Data, defaults)
{
    const struct
    {
        const char *class_name, *property, *value; // null: none
    } rows[] = {
        {"ZEMLAR_FCPort", "EnabledState", "5"},
        {"ZEMLAR_FCPort", "RequestedState", "12"},
        {"ZEMLAR_FCPort", "EnabledDefault", "2"},
        {"ZEMLAR_FCPort", "HealthState", nullptr},
        {"ZEMLAR_SCSIProtocolEndpoint", "EnabledState", nullptr},
        {"ZEMLAR_ConcreteJob", "JobRunTimes", "1"},
        {"ZEMLAR_ConcreteJob", "TimeBeforeRemoval", "\"00000000000500.000000:000\""},
        {"ZEMLAR_FCPortStatistics", "SampleInterval", "\"00000000000000.000000:000\""},
        {"ZEMLAR_LogicalDisk", "Primordial", "false"},
        {"ZEMLAR_LogicalDisk", "NameFormat", "12"},
        {"ZEMLAR_ObjectManager", "GatherStatisticalData", "true"},
        {"ZEMLAR_PhysicalPackage", "RemovalConditions", "2"},
    };
    for (const auto& row : rows)
    {
        const Ref<Instance> made(create(&class_named(row.class_name), true));
        const Meta_Property* property = as_property(&feature_named(row.class_name, row.property));
        const void* value = address_of(made.ptr(), property->offset);
        const auto print = [&](std::FILE* stream) { print_scalar(stream, static_cast<Type>(property->type), value); };
        EXPECT_EQ(null_of(made.ptr(), property) ? "none" : printed(print), row.value ? row.value : "none")
            << row.class_name << "." << row.property;
    }
}

TEST(Meta_Data, flag_words)
{
    struct Case
    {
        const char* class_name;
        const char* feature; // null: the class itself
        uint32 flags;
    };
    // clang-format off
    const Case cases[] = {
        {"ZEMLAR_FCPort",             nullptr,                 0x00000008},
        {"CIM_ManagedElement",        nullptr,                 0x00000018},
        {"ZEMLAR_ControlledBy",       nullptr,                 0x00000080},
        {"ZEMLAR_FCPortSystemDevice", nullptr,                 0x000000C0},
        {"CIM_SystemDevice",          nullptr,                 0x000001C0},
        {"CIM_Dependency",            nullptr,                 0x00000090},
        {"ZEMLAR_AlertIndication",    nullptr,                 0x00080000},
        {"ZEMLAR_FCPort",             "DeviceID",              0x02200001},
        {"ZEMLAR_FCPort",             "Caption",               0x02000001},
        {"ZEMLAR_ComputerSystem",     "Roles",                 0x42000001}, // a writable array
        {"ZEMLAR_ConcreteJob",        "InstanceID",            0x02200001}, // an override that makes a key
        {"ZEMLAR_SCSIProtocolEndpoint", "Name",                0x02200001}, // an override of a key
        {"ZEMLAR_FCPortStatistics",   "LIPCount",              0x02000201}, // a counter
        {"ZEMLAR_TapeDrive",          "UnitsUsed",             0x02010001}, // a gauge
        {"ZEMLAR_RegisteredProfile",  "RegisteredName",        0x06000001}, // required
        {"ZEMLAR_FCPort",             "AllocationState",       0x82008001}, // an experimental embedded instance
        {"ZEMLAR_ControlledBy",       "Antecedent",            0x00200002},
        {"ZEMLAR_FCPortSystemDevice", "GroupComponent",        0x00200022},
        {"ZEMLAR_FCPortSystemDevice", "PartComponent",         0x20200002},
        {"ZEMLAR_FCPort",             "RequestStateChange",    0x00000004},
        {"ZEMLAR_ObjectManager",      "ChangeAffectedElementsAssignedSequence", 0x00008004},
    };
    // clang-format on
    for (const Case& c : cases)
    {
        const uint32 flags = c.feature ? feature_named(c.class_name, c.feature).flags : class_named(c.class_name).flags;
        EXPECT_EQ(flags, c.flags) << std::hex << c.class_name << "." << (c.feature ? c.feature : "") << " is " << flags;
    }
}

TEST(Meta_Data, parameters)
{
    struct Case
    {
        const Meta_Method& method;
        const char* parameter;
        uint32 flags;
        int subscript;
    };
    const auto& change = CIM_Service_ChangeAffectedElementsAssignedSequence_method::static_meta_class;
    const auto& run = CIM_DiagnosticService_RunDiagnosticService_method::static_meta_class;
    // clang-format off
    const Case cases[] = {
        {ZEMLAR_AlarmDevice_SetAlarmState_method::static_meta_class, "State", 0x00040001, 0},
        {change, "ManagedElements",    0x04040002, 1},  // a required array of references
        {change, "AssignedSequence",   0x04040001, -1},
        {change, "Job",                0x01000002, 0},  // a reference that only goes out
        {run,    "DiagnosticSettings", 0x80040001, 0},  // an embedded instance
    };
    // clang-format on
    for (const Case& c : cases)
    {
        SCOPED_TRACE(c.parameter);
        const Meta_Feature* parameter = find_parameter(&c.method, c.parameter);
        ASSERT_NE(parameter, nullptr);
        EXPECT_EQ(parameter->flags, c.flags);
        EXPECT_EQ(is_property(parameter) ? as_property(parameter)->subscript : as_reference(parameter)->subscript, c.subscript);
    }
}

std::string upper_case(std::string name)
{
    std::ranges::transform(name, name.begin(),
                           [](char c) { return c >= 'a' && c <= 'z' ? static_cast<char>(c - 'a' + 'A') : c; });
    return name;
}

// Every feature is found in any case, under its own kind only, and nothing else is.
void expect_features_found(const Meta_Record& record)
{
    ASSERT_NE(find_entry(&record), nullptr) << record.name;
    const auto find = [&record](const std::string& name, uint32 mask)
    { return find_feature(reinterpret_cast<const Meta_Class*>(&record), name.c_str(), mask); };
    for (const Meta_Feature* feature : features_of(record))
    {
        const uint32 kind = feature->flags & (Flag_Property | Flag_Reference | Flag_Method);
        const std::string name = feature->name;
        EXPECT_EQ(find(upper_case(name), kind), feature) << record.name << "." << name;
        EXPECT_EQ(find(name, ~kind & (Flag_Property | Flag_Reference | Flag_Method)), nullptr) << record.name << "." << name;
        EXPECT_EQ(find(name + "_", ~0U), nullptr) << record.name << "." << name;
    }
    EXPECT_EQ(find("", ~0U), nullptr);
}

TEST(Meta_Data, the_index_knows_every_class_feature_and_parameter)
{
    ASSERT_EQ(own_repository_index.repository, &meta_repository());
    for (const Meta_Class* meta_class : all_classes())
    {
        EXPECT_EQ(find_meta_class(&meta_repository(), upper_case(meta_class->name).c_str()), meta_class);
        EXPECT_EQ(find_meta_class(&meta_repository(), (std::string(meta_class->name) + "2").c_str()), nullptr);
        for (const Meta_Class* c = meta_class; c; c = c->super_meta_class)
            EXPECT_EQ(find_meta_class(meta_class, c->name), c);
        expect_features_found(*meta_class);
        for_each_method(*meta_class, expect_features_found);
    }
    EXPECT_EQ(find_meta_class(&ZEMLAR_AlarmDevice::static_meta_class, "zemlar_product"), &class_named("ZEMLAR_Product"));
    EXPECT_EQ(find_meta_class(&ZEMLAR_AlarmDevice::static_meta_class, "Instance"), nullptr);
    EXPECT_EQ(find_meta_class(&meta_repository(), ""), nullptr);
}

// A class that somebody made from one of ours is another record: the index must not answer for it.
TEST(Meta_Data, the_index_is_only_for_its_own_records)
{
    const Meta_Feature* const features[] = {&feature_named("ZEMLAR_Product", "Vendor")};
    Meta_Class made = ZEMLAR_AlarmDevice::static_meta_class;
    made.meta_features = features;
    made.num_meta_features = 1;
    EXPECT_EQ(find_feature(&made, "vendor"), features[0]);
    EXPECT_EQ(find_feature(&made, "DeviceID"), nullptr);
    EXPECT_EQ(find_meta_class(&made, "ZEMLAR_AlarmDevice"), &made);

    const Meta_Class* const classes[] = {&made};
    const Meta_Repository other = {classes, 1};
    EXPECT_EQ(find_meta_class(&other, "zemlar_alarmdevice"), &made);
    EXPECT_EQ(find_meta_class(&other, "ZEMLAR_Product"), nullptr);
}

TEST(Meta_Data, an_overriding_method_replaces_the_parameters)
{
    const Meta_Feature& standard = feature_named("CIM_AlarmDevice", "SetAlarmState");
    const Meta_Feature& served = feature_named("ZEMLAR_AlarmDevice", "SetAlarmState");
    EXPECT_NE(find_parameter(as_method(&standard), "RequestedAlarmState"), nullptr);
    EXPECT_EQ(find_parameter(as_method(&served), "RequestedAlarmState"), nullptr);
    EXPECT_EQ(&served, &ZEMLAR_AlarmDevice_SetAlarmState_method::static_meta_class);
}

} // namespace
} // namespace zmlr
