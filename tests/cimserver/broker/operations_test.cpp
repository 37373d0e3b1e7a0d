// The CIM operations, answered from the test module.
#include "loaded_module.h"

#include <gmock/gmock.h>

#include <thread>

namespace cimserver
{
namespace
{

using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

using Operations_Test = Loaded_Module;

constexpr const char* zemlar = "root/zemlar";

std::vector<std::string> class_names(const std::vector<const zmlr::Meta_Class*>& classes)
{
    std::vector<std::string> result;
    for (const zmlr::Meta_Class* meta_class : classes)
        result.emplace_back(meta_class->name);
    return result;
}

TEST_F(Operations_Test, name_spaces_are_found_in_any_case_and_refused_when_unknown)
{
    EXPECT_STREQ(operations.get_class("/Root/ZEMLAR/", "tst_DISK")->name, "TST_Disk");
    for (const char* name_space : {"", "root", "root/zemlar2", "interop", "/"})
        EXPECT_EQ(error_of([&] { operations.get_class(name_space, "TST_Disk"); }), CIM_ERR_INVALID_NAMESPACE) << name_space;
}

TEST_F(Operations_Test, classes_are_enumerated_from_the_top_or_below_a_class)
{
    EXPECT_THAT(class_names(operations.enumerate_classes(zemlar, "", false)),
                ElementsAre("TST_Top", "TST_Link", "TST_Alert", "TST_Idle"));
    EXPECT_EQ(operations.enumerate_classes(zemlar, "", true).size(), 9U);
    EXPECT_THAT(class_names(operations.enumerate_classes(zemlar, "tst_top", false)), ElementsAre("TST_Base", "TST_Broken"));
    EXPECT_THAT(class_names(operations.enumerate_classes(zemlar, "TST_Top", true)),
                ElementsAre("TST_Base", "TST_Disk", "TST_Tape", "TST_Broken", "TST_Failing"));
}

TEST_F(Operations_Test, a_superclass_is_the_union_of_its_served_subclasses_without_duplicates)
{
    EXPECT_THAT(enumerate_ids("TST_Disk"), ElementsAre("TST_Disk:disk0", "TST_Disk:disk1", "TST_Disk:disk2"));
    EXPECT_THAT(enumerate_ids("TST_Tape"), ElementsAre("TST_Tape:tape0", "tst_disk:disk0"));
    EXPECT_THAT(enumerate_ids("tst_base"), ElementsAre("TST_Disk:disk0", "TST_Disk:disk1", "TST_Disk:disk2", "TST_Tape:tape0"));
    EXPECT_EQ(operations.enumerate_instances(zemlar, "TST_Base", true, {}).size(), 4U);

    EXPECT_THAT(enumerate_ids("TST_Idle"), IsEmpty());
    EXPECT_THAT(enumerate_ids("TST_Alert"), IsEmpty());
}

TEST_F(Operations_Test, one_failing_provider_fails_the_operation_with_its_code_and_message)
{
    std::string description;
    for (const char* class_name : {"TST_Failing", "TST_Broken", "TST_Top"})
    {
        EXPECT_EQ(error_of([&] { operations.enumerate_instance_names(zemlar, class_name); }), CIM_ERR_ACCESS_DENIED);
        EXPECT_EQ(error_of([&] { operations.enumerate_instances(zemlar, class_name, true, {}); }, &description),
                  CIM_ERR_ACCESS_DENIED);
        EXPECT_EQ(description, "TST_Failing_Provider: CMPI_RC_ERR_ACCESS_DENIED: the door is shut");
    }

    const std::pair<const char*, int> codes[] = {{"1", 1},  {"2", 2},  {"7", 7},   {"17", 17}, {"18", 1},
                                                 {"50", 1}, {"60", 1}, {"100", 1}, {"200", 1}, {"255", 1}};
    for (const auto& code : codes)
        EXPECT_EQ(error_of([&] { operations.get_instance(path("TST_Failing", id(code.first)), {}); }), code.second) << code.first;
    EXPECT_EQ(error_of([&] { operations.get_instance(path("TST_Top", id("100")), {}); }, &description), CIM_ERR_FAILED);
    EXPECT_EQ(description, "TST_Failing_Provider: CMPI_RC_ERROR_SYSTEM");
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
    struct Case
    {
        const char* key;
        Value value;
    };
    Value nested = reference("TST_Disk", id("disk0"));
    for (int i = 0; i < 20; ++i)
    {
        auto keys = good_keys();
        find_named(keys, "Left")->value = nested;
        nested = reference("TST_Link", keys);
    }
    const Case cases[] = {
        {"Flag", text("1")},
        {"Flag", text("")},
        {"Flag", {CMPI_uint8, std::uint64_t{1}}},
        {"Count", text("256")},
        {"Count", text("-1")},
        {"Count", text("")},
        {"Count", text("5 5")},
        {"Count", text("0x100")},
        {"Count", text("99999999999999999999999")},
        {"Count", {CMPI_boolean, true}},
        {"Count", {CMPI_sint64, std::int64_t{-1}}},
        {"Count", {CMPI_uint8, {}}},
        {"Offset", text("128")},
        {"Offset", text("-129")},
        {"Offset", {CMPI_sint64, INT64_MIN}},
        {"Mark", text("ab")},
        {"Mark", text("\xE2\x82")},
        {"Ratio", text("1.5x")},
        {"Ratio", text("inf")},
        {"When", text("yesterday")},
        {"Left", text("TST_Disk.Id=\"disk1\"")},
        {"Left", {CMPI_ref, std::shared_ptr<const Object_Path>()}},
        {"Left", reference("TST_Unknown", id("disk1"))},
        {"Left", reference("TST_Idle", {})},
        {"Left", nested},
    };
    std::string description;
    const auto refused = [&](const std::vector<Named_Value>& keys, const char* told)
    {
        EXPECT_EQ(error_of([&] { operations.get_instance(path("TST_Link", keys), {}); }, &description),
                  CIM_ERR_INVALID_PARAMETER);
        EXPECT_THAT(description, HasSubstr(told));
    };
    for (const Case& c : cases)
    {
        auto keys = good_keys();
        find_named(keys, c.key)->value = c.value;
        refused(keys, c.key);
    }
    auto keys = good_keys();
    keys.push_back({"COUNT", text("1")});
    refused(keys, "COUNT of class TST_Link: it is given twice");
    keys.back().name = "Name";
    refused(keys, "Name of class TST_Link: there is no such key");
    keys.resize(keys.size() - 2);
    refused(keys, "Left of class TST_Link: it is missing");
    keys.push_back({"Left", reference("TST_Disk", {})});
    refused(keys, "Id of class TST_Disk");
}

TEST_F(Operations_Test, methods_are_known_but_not_callable)
{
    EXPECT_EQ(error_of([&] { operations.invoke_method(path("TST_Disk", id("disk0")), "reset", {}); }),
              CIM_ERR_METHOD_NOT_AVAILABLE);
    EXPECT_EQ(error_of([&] { operations.invoke_method(path("TST_Disk", id("disk0")), "Name", {}); }), CIM_ERR_METHOD_NOT_FOUND);
    EXPECT_EQ(error_of([&] { operations.invoke_method(path("TST_Idle", {}), "Reset", {}); }), CIM_ERR_METHOD_NOT_FOUND);
}

// The tape counts the disks by asking the server, which asks the module again on the same thread.
TEST_F(Operations_Test, up_calls_come_back_into_the_module)
{
    test_module.state().disks = 5;
    const auto tapes = operations.enumerate_instances(zemlar, "TST_Tape", true, {});
    EXPECT_EQ(std::get<std::uint64_t>(find_named(tapes.at(0).properties, "Speed")->value.content), 5U);
}

TEST_F(Operations_Test, many_threads_ask_at_once)
{
    std::vector<std::thread> threads;
    for (int t = 0; t < 16; ++t)
        threads.emplace_back(
            [&]
            {
                for (int i = 0; i < 50; ++i)
                {
                    EXPECT_EQ(operations.enumerate_instances(zemlar, "TST_Base", true, {}).size(), 4U);
                    EXPECT_EQ(operations.get_instance(path("TST_Top", id("tape0")), {}).path.class_name, "TST_Tape");
                    EXPECT_EQ(error_of([&] { operations.enumerate_instance_names(zemlar, "TST_Top"); }), CIM_ERR_ACCESS_DENIED);
                }
            });
    for (std::thread& thread : threads)
        thread.join();
    EXPECT_EQ(test_module.state().live_interfaces, 3);
}

} // namespace
} // namespace cimserver
