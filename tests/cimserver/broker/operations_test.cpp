// The CIM operations, answered from the test module.
#include "loaded_module.h"

#include <gmock/gmock.h>

namespace cimserver
{
namespace
{

using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

using Operations_Test = Loaded_Module;

TEST_F(Operations_Test, a_superclass_is_the_union_of_its_served_subclasses_without_duplicates)
{
    EXPECT_THAT(enumerate_ids("TST_Disk"), ElementsAre("TST_Disk:disk0", "TST_Disk:disk1", "TST_Disk:disk2"));
    EXPECT_THAT(enumerate_ids("TST_Tape"), ElementsAre("TST_Tape:tape0", "tst_disk:disk0"));
    EXPECT_THAT(enumerate_ids("tst_base"), ElementsAre("TST_Disk:disk0", "TST_Disk:disk1", "TST_Disk:disk2", "TST_Tape:tape0"));
    EXPECT_EQ(operations.enumerate_instances("TST_Base", true, {}).size(), 4U);

    EXPECT_THAT(enumerate_ids("TST_Idle"), IsEmpty());
    EXPECT_THAT(enumerate_ids("TST_Alert"), IsEmpty());
}

TEST_F(Operations_Test, one_failing_provider_fails_the_operation_with_its_code_and_message)
{
    std::string description;
    for (const char* class_name : {"TST_Failing", "TST_Broken", "TST_Top"})
    {
        EXPECT_EQ(error_of([&] { operations.enumerate_instance_names(class_name); }), CIM_ERR_ACCESS_DENIED);
        EXPECT_EQ(error_of([&] { operations.enumerate_instances(class_name, true, {}); }, &description), CIM_ERR_ACCESS_DENIED);
        EXPECT_EQ(description, "TST_Failing: EnumerateInstances: access denied");
    }

    const std::pair<const char*, int> codes[] = {{"1", 1},  {"2", 2},  {"7", 7},   {"17", 17}, {"18", 1},
                                                 {"50", 1}, {"60", 1}, {"100", 1}, {"200", 1}, {"255", 1}};
    for (const auto& code : codes)
        EXPECT_EQ(error_of([&] { operations.get_instance(path("TST_Failing", id(code.first)), {}); }), code.second) << code.first;
    EXPECT_EQ(error_of([&] { operations.get_instance(path("TST_Top", id("100")), {}); }, &description), CIM_ERR_FAILED);
    EXPECT_EQ(description, "TST_Failing: GetInstance failed with code 100");
}

TEST_F(Operations_Test, get_instance_finds_through_superclasses_and_tells_what_is_not_there)
{
    EXPECT_EQ(operations.get_instance(path("TST_Tape", id("tape0")), {}).path.class_name, "TST_Tape");
    EXPECT_EQ(operations.get_instance(path("TST_Top", id("disk2")), {}).path.class_name, "TST_Disk");
    struct Row
    {
        const char* class_name;
        std::vector<Named_Value> keys;
        int code;
        const char* told;
    };
    const Row rows[] = {
        {"TST_Disk", id("disk3"), CIM_ERR_NOT_FOUND, "there is no instance root/zemlar:TST_Disk.Id=\"disk3\""},
        {"TST_Tape", id("tape1"), CIM_ERR_NOT_FOUND, ""}, // its provider answers OK, without a result
        {"TST_Base", id("none"), CIM_ERR_NOT_FOUND, ""},
        {"TST_Idle", {}, CIM_ERR_NOT_FOUND, ""},
        {"TST_Alert", {}, CIM_ERR_NOT_FOUND, ""},
        {"TST_Idle", id("x"), CIM_ERR_INVALID_PARAMETER, "Id"},
        {"TST_Base", {}, CIM_ERR_INVALID_PARAMETER, "Id"},
    };
    std::string description;
    for (const Row& row : rows)
    {
        const auto get = [&] { operations.get_instance(path(row.class_name, row.keys), {}); };
        EXPECT_EQ(error_of(get, &description), row.code) << row.class_name;
        EXPECT_THAT(description, HasSubstr(row.told));
    }
}

// TST_Link tells in Name which keys reached it.
class Key_Test : public Loaded_Module
{
protected:
    static Value reference(const std::string& class_name, std::vector<Named_Value> keys)
    {
        return {CMPI_ref, std::make_shared<const Object_Path>(Object_Path{"host", "", class_name, std::move(keys)})};
    }

    static std::vector<Named_Value> good_keys()
    {
        return {{"when", text("00000001000000.000000:000")},
                {"Flag", text("True")},
                {"Count", text("255")},
                {"Offset", text("-128")},
                {"Mark", text("\xE2\x82\xAC")},
                {"Ratio", text("-2.5e1")},
                {"LEFT", reference("tst_disk", id("disk1"))}};
    }
};

TEST_F(Key_Test, keys_reach_the_provider_in_class_order_with_the_types_of_the_class)
{
    const Instance link = operations.get_instance(path("TST_Link", good_keys()), {{"Name"}});
    EXPECT_EQ(std::get<std::string>(link.properties.at(0).value.content),
              R"(root/zemlar:TST_Link.Left="root/zemlar:TST_Disk.Id=\"disk1\"",Flag=TRUE,Count=255,Offset=-128,)"
              R"(Mark=8364,Ratio=-25.000000,When="00000001000000.000000:000")");

    auto typed = good_keys();
    find_named(typed, "Flag")->value = {CMPI_boolean, true};
    find_named(typed, "Count")->value = {CMPI_sint64, std::int64_t{255}};
    find_named(typed, "Offset")->value = {CMPI_sint64, std::int64_t{-128}};
    find_named(typed, "Mark")->value = {CMPI_char16, std::uint64_t{0x20AC}};
    find_named(typed, "Ratio")->value = {CMPI_real64, -25.0};
    EXPECT_EQ(std::get<std::string>(operations.get_instance(path("TST_Link", typed), {{"Name"}}).properties.at(0).value.content),
              std::get<std::string>(link.properties.at(0).value.content));
}

TEST_F(Key_Test, a_bad_key_is_refused_by_its_name)
{
    Value nested = reference("TST_Disk", id("disk0"));
    for (int i = 0; i < 20; ++i)
    {
        auto keys = good_keys();
        find_named(keys, "Left")->value = nested;
        nested = reference("TST_Link", keys);
    }
    const std::pair<const char*, Value> cases[] = {
        {"Flag", {CMPI_uint8, std::uint64_t{1}}},
        {"Count", text("0x100")},
        {"Count", {CMPI_sint64, std::int64_t{-1}}},
        {"Count", {CMPI_uint8, {}}},
        {"Mark", text("\xE2\x82")},
        {"Ratio", text("inf")},
        {"Left", text("TST_Disk.Id=\"disk1\"")},
        {"Left", {CMPI_ref, std::shared_ptr<const Object_Path>()}},
        {"Left", reference("TST_Unknown", id("disk1"))},
        {"Left", reference("TST_Idle", {})},
        {"Left", reference("TST_Disk", {})},
        {"Left", nested},
    };
    std::string description;
    for (const auto& [key, value] : cases)
    {
        auto keys = good_keys();
        find_named(keys, key)->value = value;
        EXPECT_EQ(error_of([&] { operations.get_instance(path("TST_Link", keys), {}); }, &description),
                  CIM_ERR_INVALID_PARAMETER);
        EXPECT_THAT(description, HasSubstr("key")) << key;
    }
}

// The tape counts the disks by asking the server, which asks the module again on the same thread.
TEST_F(Operations_Test, up_calls_come_back_into_the_module)
{
    test_module.state().disks = 5;
    const auto tapes = operations.enumerate_instances("TST_Tape", true, {});
    EXPECT_EQ(std::get<std::uint64_t>(find_named(tapes.at(0).properties, "Speed")->value.content), 5U);
}

} // namespace
} // namespace cimserver
