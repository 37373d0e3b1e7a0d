// The CIM operations, answered from the test module.
#include "allocation_count.h"
#include "cimserver/broker/request.h"
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

TEST_F(Operations_Test, name_spaces_and_classes_are_found_in_any_case_and_refused_when_unknown)
{
    EXPECT_STREQ(operations.get_class("/Root/ZEMLAR/", "tst_DISK")->name, "TST_Disk");
    for (const char* name_space : {"", "root", "root/zemlar2", "interop", "/"})
        EXPECT_EQ(error_of([&] { operations.get_class(name_space, "TST_Disk"); }), CIM_ERR_INVALID_NAMESPACE) << name_space;

    for (const char* class_name : {"", "TST_Dis", "TST_Disk2"})
    {
        EXPECT_EQ(error_of([&] { operations.get_class(zemlar, class_name); }), CIM_ERR_NOT_FOUND) << class_name;
        EXPECT_EQ(error_of([&] { operations.enumerate_instances(zemlar, class_name, true, {}); }), CIM_ERR_INVALID_CLASS);
        EXPECT_EQ(error_of([&] { operations.get_instance(path(class_name, {}), {}); }), CIM_ERR_INVALID_CLASS);
        EXPECT_EQ(error_of([&] { operations.invoke_method(path(class_name, {}), "Reset", {}); }), CIM_ERR_INVALID_CLASS);
    }
    EXPECT_EQ(error_of([&] { operations.enumerate_classes(zemlar, "TST_Unknown", true); }), CIM_ERR_INVALID_CLASS);
}

TEST_F(Operations_Test, classes_are_enumerated_from_the_top_or_below_a_class)
{
    EXPECT_THAT(class_names(operations.enumerate_classes(zemlar, "", false)),
                ElementsAre("TST_Top", "TST_Link", "TST_Alert", "TST_Idle"));
    EXPECT_EQ(operations.enumerate_classes(zemlar, "", true).size(), 9U);
    EXPECT_THAT(class_names(operations.enumerate_classes(zemlar, "tst_top", false)), ElementsAre("TST_Base", "TST_Broken"));
    EXPECT_THAT(class_names(operations.enumerate_classes(zemlar, "TST_Top", true)),
                ElementsAre("TST_Base", "TST_Disk", "TST_Tape", "TST_Broken", "TST_Failing"));
    EXPECT_THAT(operations.enumerate_classes(zemlar, "TST_Disk", true), IsEmpty());
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

TEST_F(Operations_Test, instances_have_every_property_of_their_class_in_order_null_ones_too)
{
    const auto disks = operations.enumerate_instances(zemlar, "TST_Disk", true, {});
    EXPECT_EQ(disks[0].properties.size(), 20U);
    EXPECT_EQ(names(disks[0]), names(disks[2]));
    EXPECT_EQ(disks[0].properties[1].name, "Name");
    EXPECT_TRUE(disks[0].properties[1].value.null());
    EXPECT_EQ(disks[0].properties[1].value.type, CMPI_string);

    const Instance& disk = disks[2];
    EXPECT_EQ(std::get<std::string>(find_named(disk.properties, "Name")->value.content), "Disk 2");
    EXPECT_EQ(std::get<bool>(find_named(disk.properties, "Boolean")->value.content), false);
    EXPECT_EQ(std::get<std::uint64_t>(find_named(disk.properties, "Uint64")->value.content), 1000000000002U);
    EXPECT_EQ(std::get<std::string>(find_named(disk.properties, "Datetime")->value.content), "19700101000002.000000+000");
    const auto& strings = std::get<std::vector<Value>>(find_named(disk.properties, "Strings")->value.content);
    EXPECT_EQ(std::get<std::string>(strings.at(1).content), "Disk 2");
    const auto& partner = std::get<std::shared_ptr<const Object_Path>>(find_named(disk.properties, "Partner")->value.content);
    EXPECT_EQ(partner->class_name, "TST_Tape");
}

TEST_F(Operations_Test, property_lists_and_shallow_inheritance_limit_what_is_shown_but_never_the_path)
{
    struct Case
    {
        const char* class_name;
        bool deep;
        Property_List properties;
        std::vector<std::string> expected; // of the first disk
    };
    const std::vector<std::string> all = names(operations.enumerate_instances(zemlar, "TST_Disk", true, {}).at(0));
    const Case cases[] = {
        {"TST_Base", true, {}, all},
        {"TST_Base", false, {}, {"Id", "Name"}},
        {"TST_Disk", false, {}, all},
        {"TST_Disk", true, {{"uint64", "Reset", "Unknown", "NAME"}}, {"Name", "Uint64"}},
        {"TST_Base", false, {{"Uint64", "Name"}}, {"Name"}},
        {"TST_Disk", true, std::vector<std::string>{}, {}},
    };
    for (const Case& c : cases)
    {
        SCOPED_TRACE(c.class_name);
        const auto found = operations.enumerate_instances(zemlar, c.class_name, c.deep, c.properties);
        EXPECT_EQ(names(found.at(1)), c.expected);
        EXPECT_EQ(std::get<std::string>(found.at(1).path.keys.at(0).value.content), "disk1");
    }
    const Instance disk = operations.get_instance(path("TST_Disk", id("disk1")), {{"Name"}});
    EXPECT_THAT(names(disk), ElementsAre("Name"));
    EXPECT_EQ(std::get<std::string>(disk.properties[0].value.content), "Disk 1");
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
    EXPECT_EQ(operations.get_instance(path("tst_base", id("tape0")), {}).path.class_name, "TST_Tape");
    EXPECT_EQ(operations.get_instance(path("TST_Top", id("disk2")), {}).path.class_name, "TST_Disk");

    std::string description;
    EXPECT_EQ(error_of([&] { operations.get_instance(path("TST_Disk", id("disk3")), {}); }, &description), CIM_ERR_NOT_FOUND);
    EXPECT_EQ(description, "there is no instance root/zemlar:TST_Disk.Id=\"disk3\"");
    EXPECT_EQ(error_of([&] { operations.get_instance(path("TST_Tape", id("tape1")), {}); }), CIM_ERR_NOT_FOUND);
    EXPECT_EQ(error_of([&] { operations.get_instance(path("TST_Base", id("none")), {}); }), CIM_ERR_NOT_FOUND);
    EXPECT_EQ(error_of([&] { operations.get_instance(path("TST_Idle", {}), {}); }), CIM_ERR_NOT_FOUND);
    EXPECT_EQ(error_of([&] { operations.get_instance(path("TST_Alert", {}), {}); }), CIM_ERR_NOT_FOUND);
    EXPECT_EQ(error_of([&] { operations.get_instance(path("TST_Idle", id("x")), {}); }, &description), CIM_ERR_INVALID_PARAMETER);
    EXPECT_THAT(description, HasSubstr("Id"));
    EXPECT_EQ(error_of([&] { operations.get_instance(path("TST_Base", {}), {}); }, &description), CIM_ERR_INVALID_PARAMETER);
    EXPECT_THAT(description, HasSubstr("Id"));
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
    for (const Case& c : cases)
    {
        auto keys = good_keys();
        find_named(keys, c.key)->value = c.value;
        EXPECT_EQ(error_of([&] { operations.get_instance(path("TST_Link", keys), {}); }, &description),
                  CIM_ERR_INVALID_PARAMETER);
        EXPECT_THAT(description, HasSubstr(c.key));
    }

    auto keys = good_keys();
    keys.push_back({"COUNT", text("1")});
    EXPECT_EQ(error_of([&] { operations.get_instance(path("TST_Link", keys), {}); }, &description), CIM_ERR_INVALID_PARAMETER);
    EXPECT_THAT(description, HasSubstr("COUNT of class TST_Link: it is given twice"));
    keys.back().name = "Name";
    EXPECT_EQ(error_of([&] { operations.get_instance(path("TST_Link", keys), {}); }, &description), CIM_ERR_INVALID_PARAMETER);
    EXPECT_THAT(description, HasSubstr("Name of class TST_Link: there is no such key"));
    keys.pop_back();
    keys.pop_back();
    EXPECT_EQ(error_of([&] { operations.get_instance(path("TST_Link", keys), {}); }, &description), CIM_ERR_INVALID_PARAMETER);
    EXPECT_THAT(description, HasSubstr("Left of class TST_Link: it is missing"));
    keys.push_back({"Left", reference("TST_Disk", {})});
    EXPECT_EQ(error_of([&] { operations.get_instance(path("TST_Link", keys), {}); }, &description), CIM_ERR_INVALID_PARAMETER);
    EXPECT_THAT(description, HasSubstr("Id of class TST_Disk"));
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

// As a thread of the module may do it: attached, outside any request.
TEST_F(Operations_Test, the_broker_reads_instances_for_providers)
{
    Request request;
    const CMPIBroker* broker = module.broker().face();
    CMPIStatus status{};
    CMPIObjectPath* disk_path = broker->eft->newObjectPath(broker, zemlar, "TST_Disk", nullptr);
    const char* properties[] = {"Name", nullptr};
    CMPIEnumeration* disks = broker->bft->enumerateInstances(broker, request.context(), disk_path, properties, &status);
    ASSERT_EQ(status.rc, CMPI_RC_OK);
    int count = 0;
    for (; disks->ft->hasNext(disks, nullptr); ++count)
    {
        const CMPIInstance* disk = disks->ft->getNext(disks, nullptr).value.inst;
        EXPECT_EQ(disk->ft->getPropertyCount(disk, nullptr), 1U);
    }
    EXPECT_EQ(count, 3);
    EXPECT_EQ((disks->ft->getNext(disks, &status), status.rc), CMPI_RC_ERR_NOT_FOUND);

    EXPECT_EQ(broker->bft->getInstance(broker, request.context(), disk_path, nullptr, &status), nullptr);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_PARAMETER);
    disk_path->ft->addKey(disk_path, "Id", reinterpret_cast<const CMPIValue*>("disk1"), CMPI_chars);
    CMPIInstance* disk = broker->bft->getInstance(broker, request.context(), disk_path, nullptr, &status);
    ASSERT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(disk->ft->getProperty(disk, "Uint64", nullptr).value.uint64, 1000000000001U);
    EXPECT_EQ(broker->bft->deleteInstance(broker, request.context(), disk_path).rc, CMPI_RC_ERR_NOT_SUPPORTED);
}

TEST_F(Operations_Test, requests_leave_no_memory_behind_and_large_answers_are_complete)
{
    test_module.state().disks = 10000;
    EXPECT_EQ(enumerate_ids("TST_Base").size(), 10001U);
    EXPECT_EQ(operations.enumerate_instances(zemlar, "TST_Base", true, {}).size(), 10001U);

    test_module.state().disks = 3;
    const long before = live_allocations();
    for (int i = 0; i < 300; ++i)
    {
        operations.enumerate_instances(zemlar, "TST_Base", false, {{"Name", "Uint64"}});
        operations.get_instance(path("TST_Tape", id("tape0")), {});
        error_of([&] { operations.enumerate_instances(zemlar, "TST_Top", true, {}); });
        error_of([&] { operations.get_instance(path("TST_Disk", id("disk9")), {}); });
    }
    EXPECT_EQ(live_allocations(), before);
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
