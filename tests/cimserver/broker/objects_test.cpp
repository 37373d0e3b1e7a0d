// The broker's objects as a provider sees them: through their function tables.
#include "allocation_count.h"
#include "cimserver/broker/broker.h"
#include "cimserver/broker/conversion.h"
#include "cimserver/broker/request.h"
#include "test_schema.h"

#include <cmpimacs.h>
#include <gtest/gtest.h>

#include <climits>
#include <cstring>
#include <thread>

namespace cimserver
{
namespace
{

constexpr CMPIType array(CMPIType type) { return static_cast<CMPIType>(type | CMPI_ARRAY); }

class Objects : public ::testing::Test
{
protected:
    CMPIObjectPath* path(const char* class_name) { return CMNewObjectPath(broker, "root/zemlar", class_name, nullptr); }
    CMPIInstance* disk() { return CMNewInstance(broker, path("TST_Disk"), nullptr); }

    static std::string text(const CMPIString* string) { return CMGetCharsPtr(string, nullptr); }

    static CMPIrc set(CMPIInstance* instance, const char* name, CMPIType type, const CMPIValue& value)
    {
        return CMSetProperty(instance, name, &value, type).rc;
    }

    static CMPIData get(const CMPIInstance* instance, const char* name) { return CMGetProperty(instance, name, nullptr); }

    static std::vector<std::string> names(const CMPIInstance* instance)
    {
        std::vector<std::string> result;
        for (CMPICount i = 0; i < CMGetPropertyCount(instance, nullptr); ++i)
        {
            CMPIString* name = nullptr;
            CMGetPropertyAt(instance, i, &name, nullptr);
            result.push_back(text(name));
        }
        return result;
    }

    Repository repository{test_registrations()};
    Broker owner{repository};
    const CMPIBroker* broker = owner.face();
    Request request;
};

CMPIValue value_of(auto CMPIValue::*member, auto content)
{
    CMPIValue value{};
    value.*member = static_cast<std::remove_reference_t<decltype(value.*member)>>(content);
    return value;
}

TEST_F(Objects, every_scalar_comes_back_from_its_property_with_its_extremes)
{
    struct Case
    {
        const char* property;
        CMPIType type;
        CMPIValue value;
    };
    // clang-format off
    const Case cases[] = {
        {"Boolean",  CMPI_boolean, value_of(&CMPIValue::boolean, 1)},
        {"Uint8",    CMPI_uint8,   value_of(&CMPIValue::uint8, UINT8_MAX)},
        {"Sint8",    CMPI_sint8,   value_of(&CMPIValue::sint8, INT8_MIN)},
        {"Uint16",   CMPI_uint16,  value_of(&CMPIValue::uint16, UINT16_MAX)},
        {"Sint16",   CMPI_sint16,  value_of(&CMPIValue::sint16, INT16_MIN)},
        {"Uint32",   CMPI_uint32,  value_of(&CMPIValue::uint32, UINT32_MAX)},
        {"Sint32",   CMPI_sint32,  value_of(&CMPIValue::sint32, INT32_MIN)},
        {"Uint64",   CMPI_uint64,  value_of(&CMPIValue::uint64, UINT64_MAX)},
        {"Sint64",   CMPI_sint64,  value_of(&CMPIValue::sint64, INT64_MIN)},
        {"Real32",   CMPI_real32,  value_of(&CMPIValue::real32, 0.1F)},
        {"Real64",   CMPI_real64,  value_of(&CMPIValue::real64, -1e300)},
        {"Char16",   CMPI_char16,  value_of(&CMPIValue::char16, 0xFFFD)},
    };
    // clang-format on
    CMPIInstance* instance = disk();
    for (const Case& c : cases)
    {
        SCOPED_TRACE(c.property);
        EXPECT_EQ(get(instance, c.property).state, CMPI_nullValue);
        EXPECT_EQ(get(instance, c.property).type, c.type);
        EXPECT_EQ(set(instance, c.property, c.type, c.value), CMPI_RC_OK);
        const CMPIData data = get(instance, c.property);
        EXPECT_EQ(data.type, c.type);
        EXPECT_EQ(data.state, CMPI_goodValue);
        EXPECT_EQ(std::memcmp(&data.value, &c.value, sizeof(CMPIUint64)), 0);

        EXPECT_EQ(set(instance, "Name", c.type, c.value), CMPI_RC_ERR_TYPE_MISMATCH);
        EXPECT_EQ(CMSetProperty(instance, c.property, nullptr, c.type).rc, CMPI_RC_OK);
        EXPECT_EQ(get(instance, c.property).state, CMPI_nullValue);
    }
}

TEST_F(Objects, texts_keep_their_bytes_in_every_form_that_they_may_arrive_in)
{
    const char* bytes = "a\x01\xff\xc3\xa4";
    CMPIInstance* instance = disk();
    EXPECT_EQ(CMSetProperty(instance, "name", bytes, CMPI_chars).rc, CMPI_RC_OK);
    EXPECT_EQ(text(get(instance, "NAME").value.string), bytes);

    CMPIString* string = CMNewString(broker, bytes, nullptr);
    EXPECT_EQ(CMSetProperty(instance, "Id", &string, CMPI_string).rc, CMPI_RC_OK);
    EXPECT_EQ(text(get(instance, "Id").value.string), bytes);

    string = nullptr;
    EXPECT_EQ(CMSetProperty(instance, "Id", &string, CMPI_string).rc, CMPI_RC_OK);
    EXPECT_EQ(CMSetProperty(instance, "Name", nullptr, CMPI_chars).rc, CMPI_RC_OK);
    EXPECT_EQ(get(instance, "Id").state, CMPI_nullValue);
    EXPECT_EQ(get(instance, "Name").state, CMPI_nullValue);
    EXPECT_EQ(CMNewString(broker, nullptr, nullptr), nullptr);
}

TEST_F(Objects, arrays_hold_their_element_type_and_nothing_else)
{
    CMPIArray* strings = CMNewArray(broker, 3, CMPI_chars, nullptr);
    CMPIString* string = CMNewString(broker, "second", nullptr);
    EXPECT_EQ(CMGetArrayType(strings, nullptr), CMPI_string);
    EXPECT_EQ(CMSetArrayElementAt(strings, 0, "first", CMPI_chars).rc, CMPI_RC_OK);
    EXPECT_EQ(CMSetArrayElementAt(strings, 1, &string, CMPI_string).rc, CMPI_RC_OK);
    const CMPIUint16 number = 7;
    EXPECT_EQ(CMSetArrayElementAt(strings, 2, &number, CMPI_uint16).rc, CMPI_RC_ERR_TYPE_MISMATCH);
    EXPECT_EQ(CMSetArrayElementAt(strings, 3, "fourth", CMPI_chars).rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);

    CMPIInstance* instance = disk();
    EXPECT_EQ(CMSetProperty(instance, "Uint16s", &strings, array(CMPI_string)).rc, CMPI_RC_ERR_TYPE_MISMATCH);
    EXPECT_EQ(CMSetProperty(instance, "Uint16s", &strings, array(CMPI_uint16)).rc, CMPI_RC_ERR_TYPE_MISMATCH);
    EXPECT_EQ(CMSetProperty(instance, "Strings", &strings, array(CMPI_string)).rc, CMPI_RC_OK);
    EXPECT_EQ(CMSetArrayElementAt(strings, 0, "changed later", CMPI_chars).rc, CMPI_RC_OK);

    const CMPIArray* back = get(instance, "Strings").value.array;
    EXPECT_EQ(CMGetArrayCount(back, nullptr), 3U);
    EXPECT_EQ(text(CMGetArrayElementAt(back, 0, nullptr).value.string), "first");
    EXPECT_EQ(text(CMGetArrayElementAt(back, 1, nullptr).value.string), "second");
    EXPECT_EQ(CMGetArrayElementAt(back, 2, nullptr).state, CMPI_nullValue);

    CMPIStatus status{};
    EXPECT_EQ(CMNewArray(broker, 0, array(CMPI_uint8), &status), nullptr);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_DATA_TYPE);
    EXPECT_EQ(CMNewArray(broker, UINT32_MAX, CMPI_uint8, &status), nullptr);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_PARAMETER);
}

TEST_F(Objects, datetimes_agree_in_text_and_binary_form)
{
    struct Case
    {
        const char* text;
        CMPIUint64 usec;
        bool interval;
    };
    const Case cases[] = {
        {"19700101000000.000000+000", 0, false},
        {"20000229235959.999999+000", 951868799999999, false},
        {"20000301010000.000000+060", 951868800000000, false},
        {"19991231190000.000000-300", 946684800000000, false},
        {"99991231235959.999999+000", 253402300799999999, false},
        {"00000000000000.000000+000", 0, false}, // an unset clock
        {"00000000000000.000000:000", 0, true},
        {"00000001020304.000005:000", 93784000005, true},
        {"99999999235959.999999:000", 8639999999999999999ULL, true},
    };
    for (const Case& c : cases)
    {
        SCOPED_TRACE(c.text);
        CMPIDateTime* datetime = CMNewDateTimeFromChars(broker, c.text, nullptr);
        ASSERT_NE(datetime, nullptr);
        EXPECT_EQ(text(CMGetStringFormat(datetime, nullptr)), c.text);
        EXPECT_EQ(CMGetBinaryFormat(datetime, nullptr), c.usec);
        EXPECT_EQ(CMIsInterval(datetime, nullptr), c.interval ? 1 : 0);

        CMPIDateTime* again = CMNewDateTimeFromBinary(broker, c.usec, c.interval ? 1 : 0, nullptr);
        EXPECT_EQ(
            CMGetBinaryFormat(CMNewDateTimeFromChars(broker, text(CMGetStringFormat(again, nullptr)).c_str(), nullptr), nullptr),
            c.usec);
    }
    for (const char* bad : {"", "20000101", "20000101000000.000000+00", "20000101000000.000000+0000", "2000010100000a.000000+000",
                            "20000101240000.000000+000", "20000101006000.000000:000", "20000101000000,000000+000"})
        EXPECT_EQ(CMNewDateTimeFromChars(broker, bad, nullptr), nullptr) << bad;
    EXPECT_EQ(CMNewDateTimeFromBinary(broker, 253402300800000000, 0, nullptr), nullptr);
    EXPECT_EQ(CMNewDateTimeFromBinary(broker, 8640000000000000000ULL, 1, nullptr), nullptr);
    EXPECT_GT(CMGetBinaryFormat(CMNewDateTime(broker, nullptr), nullptr), 1700000000000000U);
}

TEST_F(Objects, paths_hold_typed_keys_and_print_as_one_line)
{
    CMPIObjectPath* target = path("TST_Disk");
    CMAddKey(target, "Id", "a\"b", CMPI_chars);
    CMPIObjectPath* link = path("TST_Link");
    const CMPISint64 number = -5;
    const CMPIBoolean flag = 1;
    EXPECT_EQ(CMAddKey(link, "Left", &target, CMPI_keyRef).rc, CMPI_RC_OK);
    EXPECT_EQ(CMAddKey(link, "Count", "replaced", CMPI_chars).rc, CMPI_RC_OK);
    EXPECT_EQ(CMAddKey(link, "COUNT", &number, CMPI_keyInteger).rc, CMPI_RC_OK);
    EXPECT_EQ(CMAddKey(link, "Flag", &flag, CMPI_keyBoolean).rc, CMPI_RC_OK);
    EXPECT_EQ(CMAddKey(link, "Null", nullptr, CMPI_string).rc, CMPI_RC_ERR_INVALID_PARAMETER);
    EXPECT_EQ(CMAddKey(link, nullptr, &flag, CMPI_boolean).rc, CMPI_RC_ERR_INVALID_PARAMETER);

    EXPECT_EQ(CMGetKeyCount(link, nullptr), 3U);
    EXPECT_EQ(CMGetKey(link, "count", nullptr).value.sint64, -5);
    EXPECT_EQ(CMGetKey(link, "count", nullptr).state, CMPI_keyValue);
    EXPECT_EQ(text(CMGetKey(CMGetKey(link, "Left", nullptr).value.ref, "Id", nullptr).value.string), "a\"b");
    CMPIStatus status{};
    EXPECT_EQ(CMGetKeyAt(link, 3, nullptr, &status).state, CMPI_notFound);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(text(broker->eft->toString(broker, link, nullptr)),
              R"(root/zemlar:TST_Link.Left="root/zemlar:TST_Disk.Id=\"a\\\"b\"",Count=-5,Flag=TRUE)");

    CMSetHostname(target, "host");
    CMPIObjectPath* other = CMNewObjectPath(broker, nullptr, "TST_Disk", nullptr);
    CMSetHostAndNameSpaceFromObjectPath(other, target);
    EXPECT_EQ(text(CMGetHostname(other, nullptr)), "host");
    EXPECT_EQ(text(CMGetNameSpace(other, nullptr)), "root/zemlar");
    EXPECT_TRUE(CMClassPathIsA(broker, target, "tst_top", nullptr));
    EXPECT_FALSE(CMClassPathIsA(broker, target, "TST_Tape", nullptr));
}

TEST_F(Objects, instances_carry_references_and_embedded_instances_as_copies)
{
    CMPIObjectPath* target = path("TST_Tape");
    CMAddKey(target, "Id", "tape9", CMPI_chars);
    CMPIInstance* tape = CMNewInstance(broker, target, nullptr);
    const CMPIUint32 speed = 6;
    CMSetProperty(tape, "Speed", &speed, CMPI_uint32);

    CMPIInstance* instance = disk();
    EXPECT_EQ(CMSetProperty(instance, "Partner", &target, CMPI_ref).rc, CMPI_RC_OK);
    EXPECT_EQ(CMSetProperty(instance, "Detail", &tape, CMPI_instance).rc, CMPI_RC_OK);
    EXPECT_EQ(CMSetProperty(instance, "Partner", &tape, CMPI_instance).rc, CMPI_RC_ERR_TYPE_MISMATCH);
    EXPECT_EQ(CMSetProperty(instance, "Partner", &tape, CMPI_ref).rc, CMPI_RC_ERR_INVALID_HANDLE);
    CMRelease(tape);
    CMRelease(target);

    EXPECT_EQ(text(CMGetKey(get(instance, "Partner").value.ref, "Id", nullptr).value.string), "tape9");
    EXPECT_EQ(get(get(instance, "Detail").value.inst, "Speed").value.uint32, 6U);
}

TEST_F(Objects, a_property_filter_hides_all_but_the_listed_properties_and_the_keys)
{
    CMPIInstance* instance = disk();
    const CMPIUint8 number = 5;
    const char* properties[] = {"uint8", "NoSuchProperty", nullptr};
    const char* nothing[] = {nullptr};
    EXPECT_EQ(names(instance).size(), 20U);
    EXPECT_EQ(CMSetPropertyFilter(instance, properties, nothing).rc, CMPI_RC_OK);
    EXPECT_EQ(names(instance), (std::vector<std::string>{"Id", "Uint8"}));
    EXPECT_EQ(CMSetProperty(instance, "Uint8", &number, CMPI_uint8).rc, CMPI_RC_OK);
    EXPECT_EQ(CMSetProperty(instance, "Name", "hidden", CMPI_chars).rc, CMPI_RC_OK);
    EXPECT_EQ(CMSetProperty(instance, "NoSuchProperty", "x", CMPI_chars).rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    CMPIStatus status{};
    CMGetProperty(instance, "Name", &status);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);

    EXPECT_EQ(CMSetPropertyFilter(instance, nothing, nullptr).rc, CMPI_RC_OK);
    EXPECT_EQ(names(instance), std::vector<std::string>{"Id"});
    EXPECT_EQ(CMSetPropertyFilter(instance, nullptr, nullptr).rc, CMPI_RC_OK);
    EXPECT_EQ(get(instance, "Name").state, CMPI_nullValue);
    EXPECT_EQ(get(instance, "Uint8").value.uint8, 5);
}

TEST_F(Objects, broken_handles_are_refused)
{
    CMPIStatus status{};
    const auto refused = [&] { return std::exchange(status.rc, CMPI_RC_OK) == CMPI_RC_ERR_INVALID_HANDLE; };
    const CMPIInstance* instance = disk();
    const CMPIString* string = CMNewString(broker, "x", nullptr);

    EXPECT_TRUE((instance->ft->getProperty(nullptr, "Id", &status), refused()));
    const CMPIInstance no_object{nullptr, instance->ft};
    EXPECT_TRUE((instance->ft->getPropertyCount(&no_object, &status), refused()));
    EXPECT_TRUE((string->ft->getCharPtr(reinterpret_cast<const CMPIString*>(instance), &status), refused()));
    EXPECT_TRUE((CMNewInstance(broker, nullptr, &status), refused()));
    EXPECT_TRUE((broker->eft->getType(broker, broker, &status), refused()));
    EXPECT_EQ(string->ft->release(nullptr).rc, CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(CMNewInstance(broker, path("TST_Unknown"), &status), nullptr);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_CLASS);
    EXPECT_EQ(broker->eft->newInstance(nullptr, path("TST_Disk"), nullptr), nullptr);
}

TEST_F(Objects, a_type_that_no_value_has_is_refused_everywhere)
{
    CMPIInstance* instance = disk();
    CMPIArgs* args = CMNewArgs(broker, nullptr);
    const CMPIValue value{};
    for (const int code : {CMPI_args, CMPI_class, CMPI_filter, CMPI_enumeration, CMPI_ptr, CMPI_charsptr, 0x7777})
    {
        const auto type = static_cast<CMPIType>(code);
        EXPECT_EQ(CMSetProperty(instance, "Name", &value, type).rc, CMPI_RC_ERR_INVALID_DATA_TYPE) << type;
        EXPECT_EQ(CMAddArg(args, "a", &value, type).rc, CMPI_RC_ERR_INVALID_DATA_TYPE) << type;
    }
    EXPECT_EQ(CMGetArgCount(args, nullptr), 0U);
}

TEST_F(Objects, clones_are_independent_and_outlive_the_request)
{
    CMPIInstance* clone = nullptr;
    CMPIArgs* args_clone = nullptr;
    {
        const Request inner;
        CMPIInstance* instance = disk();
        CMSetProperty(instance, "Name", "before", CMPI_chars);
        clone = CMClone(instance, nullptr);
        CMSetProperty(instance, "Name", "after", CMPI_chars);
        CMPIArgs* args = CMNewArgs(broker, nullptr);
        CMAddArg(args, "Text", "x", CMPI_chars);
        args_clone = CMClone(args, nullptr);
    }
    EXPECT_EQ(text(get(clone, "Name").value.string), "before");
    EXPECT_EQ(text(CMGetArg(args_clone, "text", nullptr).value.string), "x");
    EXPECT_EQ(CMRelease(clone).rc, CMPI_RC_OK);
    EXPECT_EQ(CMRelease(args_clone).rc, CMPI_RC_OK);
}

TEST_F(Objects, a_request_frees_what_was_made_in_it_and_nothing_of_the_request_around_it)
{
    CMPIString* outer = CMNewString(broker, "a text that is too long to be kept inside a std::string", nullptr);
    const long before = live_allocations();
    {
        const Request inner;
        for (int i = 0; i < 100; ++i)
        {
            CMPIInstance* instance = disk();
            CMPIArray* strings = CMNewArray(broker, 10, CMPI_string, nullptr);
            CMSetProperty(instance, "Strings", &strings, array(CMPI_string));
            get(instance, "Strings");
            if (i % 2 == 0)
                CMRelease(instance);
        }
        EXPECT_GT(live_allocations(), before + 100);
    }
    EXPECT_EQ(live_allocations(), before);
    EXPECT_EQ(text(outer).size(), 55U);
}

TEST_F(Objects, messages_take_their_values_in_any_order)
{
    const auto message = [&](const char* text, CMPICount count, auto... values)
    { return broker->eft->getMessage(broker, "id", text, nullptr, count, values...); };
    CMPIString* name = CMNewString(broker, "disk0", nullptr);
    EXPECT_EQ(
        text(message("$1 holds $0 of $2 bytes; $3 costs 5$", 3, CMPI_sint32, -4, CMPI_string, name, CMPI_uint64, UINT64_MAX)),
        "disk0 holds -4 of 18446744073709551615 bytes; $3 costs 5$");
    EXPECT_EQ(message("$0", 1, CMPI_ref, nullptr), nullptr);
    EXPECT_EQ(message(nullptr, 0), nullptr);
}

// What an attached thread makes lives until it detaches, the context that it was given included.
TEST_F(Objects, an_attached_thread_frees_its_objects_when_it_detaches)
{
    const auto work_attached = [&]
    {
        CMPIContext* context = broker->bft->prepareAttachThread(broker, request.context());
        std::thread(
            [&]
            {
                EXPECT_EQ(broker->bft->attachThread(broker, context).rc, CMPI_RC_OK);
                EXPECT_EQ(text(CMGetContextEntry(context, CMPIPrincipal, nullptr).value.string), "root");
                const long attached = live_allocations();
                for (int i = 0; i < 100; ++i)
                    disk();
                EXPECT_GT(live_allocations(), attached + 100);
                EXPECT_EQ(broker->bft->detachThread(broker, context).rc, CMPI_RC_OK);
                EXPECT_LE(live_allocations(), attached);
                EXPECT_EQ(broker->bft->detachThread(broker, request.context()).rc, CMPI_RC_ERR_FAILED);
            })
            .join();
    };
    work_attached(); // the first thread of a process leaves memory of its own behind
    const long before = live_allocations();
    work_attached();
    EXPECT_EQ(live_allocations(), before);
}

TEST_F(Objects, system_services_run_threads_that_meet_at_a_condition)
{
    struct Meeting
    {
        const CMPIBrokerExtFT* services;
        CMPI_MUTEX_TYPE mutex;
        CMPI_COND_TYPE condition;
        CMPI_THREAD_KEY_TYPE key;
        bool arrived;
    };
    const CMPIBrokerExtFT* services = broker->xft;
    Meeting meeting{services, services->newMutex(0), services->newCondition(0), 0, false};
    ASSERT_EQ(services->createThreadKey(&meeting.key, nullptr), 0);
    CMPI_THREAD_TYPE thread = services->newThread(
        [](void* parameter) -> CMPI_THREAD_RETURN
        {
            auto& m = *static_cast<Meeting*>(parameter);
            m.services->setThreadSpecific(m.key, parameter);
            m.services->lockMutex(m.mutex);
            m.arrived = true;
            m.services->signalCondition(m.condition);
            m.services->unlockMutex(m.mutex);
            m.services->exitThread(m.services->getThreadSpecific(m.key));
            return nullptr;
        },
        &meeting, 0);

    services->lockMutex(meeting.mutex);
    while (!meeting.arrived)
        EXPECT_EQ(services->condWait(meeting.condition, meeting.mutex), 0);
    services->unlockMutex(meeting.mutex);
    CMPI_THREAD_RETURN result = nullptr;
    EXPECT_EQ(services->joinThread(thread, &result), 0);
    EXPECT_EQ(result, &meeting);
    services->destroyCondition(meeting.condition);
    services->destroyMutex(meeting.mutex);
    services->destroyThreadKey(meeting.key);
}

} // namespace
} // namespace cimserver
