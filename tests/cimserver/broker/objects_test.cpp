// The broker's objects as a provider sees them: through their function tables.
#include "cimserver/broker/broker.h"
#include "cimserver/broker/conversion.h"
#include "cimserver/broker/request.h"
#include "test_schema.h"

#include <cmpimacs.h>
#include <gtest/gtest.h>

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

    static CMPIData get(const CMPIInstance* instance, const char* name) { return CMGetProperty(instance, name, nullptr); }

    Repository repository{test_registrations()};
    Broker owner{repository};
    const CMPIBroker* broker = owner.face();
    Request request;
};

// A broker takes a text as CMPI_chars too: the argument is then the text itself.
TEST_F(Objects, texts_keep_their_bytes_in_every_form_that_they_may_arrive_in)
{
    const char* bytes = "a\x01\xff\xc3\xa4";
    CMPIInstance* instance = disk();
    EXPECT_EQ(CMSetProperty(instance, "name", bytes, CMPI_chars).rc, CMPI_RC_OK);
    EXPECT_EQ(text(get(instance, "NAME").value.string), bytes);
    EXPECT_EQ(CMSetProperty(instance, "Name", nullptr, CMPI_chars).rc, CMPI_RC_OK);
    EXPECT_EQ(get(instance, "Name").state, CMPI_nullValue);
    EXPECT_EQ(CMNewString(broker, nullptr, nullptr), nullptr);
}

TEST_F(Objects, arrays_hold_their_element_type_and_nothing_else)
{
    CMPIArray* strings = CMNewArray(broker, 2, CMPI_chars, nullptr);
    const CMPIUint16 number = 7;
    EXPECT_EQ(CMGetArrayType(strings, nullptr), CMPI_string);
    EXPECT_EQ(CMSetArrayElementAt(strings, 0, "first", CMPI_chars).rc, CMPI_RC_OK);
    EXPECT_EQ(CMSetArrayElementAt(strings, 1, &number, CMPI_uint16).rc, CMPI_RC_ERR_TYPE_MISMATCH);
    EXPECT_EQ(CMSetArrayElementAt(strings, 2, "third", CMPI_chars).rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);

    CMPIInstance* instance = disk();
    EXPECT_EQ(CMSetProperty(instance, "Uint16s", &strings, array(CMPI_string)).rc, CMPI_RC_ERR_TYPE_MISMATCH);
    EXPECT_EQ(CMSetProperty(instance, "Uint16s", &strings, array(CMPI_uint16)).rc, CMPI_RC_ERR_TYPE_MISMATCH);
    EXPECT_EQ(CMSetProperty(instance, "Strings", &strings, array(CMPI_string)).rc, CMPI_RC_OK);
    CMSetArrayElementAt(strings, 0, "changed later", CMPI_chars);
    const CMPIArray* back = get(instance, "Strings").value.array;
    EXPECT_EQ(text(CMGetArrayElementAt(back, 0, nullptr).value.string), "first");
    EXPECT_EQ(CMGetArrayElementAt(back, 1, nullptr).state, CMPI_nullValue);

    CMPIStatus status{};
    EXPECT_EQ((CMNewArray(broker, 0, array(CMPI_uint8), &status), status.rc), CMPI_RC_ERR_INVALID_DATA_TYPE);
    EXPECT_EQ((CMNewArray(broker, UINT32_MAX, CMPI_uint8, &status), status.rc), CMPI_RC_ERR_INVALID_PARAMETER);
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
    CMAddKey(link, "Left", &target, CMPI_keyRef);
    CMAddKey(link, "Count", "replaced", CMPI_chars);
    CMAddKey(link, "COUNT", &number, CMPI_keyInteger);
    CMAddKey(link, "Flag", &flag, CMPI_keyBoolean);
    EXPECT_EQ(CMAddKey(link, "Null", nullptr, CMPI_string).rc, CMPI_RC_ERR_INVALID_PARAMETER);
    EXPECT_EQ(CMAddKey(link, nullptr, &flag, CMPI_boolean).rc, CMPI_RC_ERR_INVALID_PARAMETER);
    EXPECT_EQ(CMGetKey(link, "count", nullptr).state, CMPI_keyValue);
    CMPIStatus status{};
    EXPECT_EQ(CMGetKeyAt(link, 3, nullptr, &status).state, CMPI_notFound);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(text(broker->eft->toString(broker, link, nullptr)),
              R"(root/zemlar:TST_Link.Left="root/zemlar:TST_Disk.Id=\"a\\\"b\"",Count=-5,Flag=TRUE)");
    EXPECT_TRUE(CMClassPathIsA(broker, target, "tst_top", nullptr));
    EXPECT_FALSE(CMClassPathIsA(broker, target, "TST_Tape", nullptr));
}

TEST_F(Objects, a_property_filter_hides_all_but_the_listed_properties_and_the_keys)
{
    CMPIInstance* instance = disk();
    const char* properties[] = {"uint8", "NoSuchProperty", nullptr};
    EXPECT_EQ(CMGetPropertyCount(instance, nullptr), 6U);
    EXPECT_EQ(CMSetPropertyFilter(instance, properties, nullptr).rc, CMPI_RC_OK);
    EXPECT_EQ(CMGetPropertyCount(instance, nullptr), 2U);
    CMPIString* second = nullptr;
    CMGetPropertyAt(instance, 1, &second, nullptr);
    EXPECT_EQ(text(second), "Uint8");
    EXPECT_EQ(CMSetProperty(instance, "Name", "hidden", CMPI_chars).rc, CMPI_RC_OK);
    EXPECT_EQ(CMSetProperty(instance, "NoSuchProperty", "x", CMPI_chars).rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    CMPIStatus status{};
    EXPECT_EQ((CMGetProperty(instance, "Name", &status), status.rc), CMPI_RC_ERR_NO_SUCH_PROPERTY);
    EXPECT_EQ(CMSetPropertyFilter(instance, nullptr, nullptr).rc, CMPI_RC_OK);
    EXPECT_EQ(get(instance, "Name").state, CMPI_nullValue) << "what is set while it is hidden is dropped";
}

TEST_F(Objects, broken_handles_and_types_that_no_value_has_are_refused)
{
    CMPIStatus status{};
    const auto refused = [&] { return std::exchange(status.rc, CMPI_RC_OK) == CMPI_RC_ERR_INVALID_HANDLE; };
    CMPIInstance* instance = disk();
    const CMPIString* string = CMNewString(broker, "x", nullptr);
    EXPECT_TRUE((instance->ft->getProperty(nullptr, "Id", &status), refused()));
    const CMPIInstance no_object{nullptr, instance->ft};
    EXPECT_TRUE((instance->ft->getPropertyCount(&no_object, &status), refused()));
    EXPECT_TRUE((string->ft->getCharPtr(reinterpret_cast<const CMPIString*>(instance), &status), refused()));
    EXPECT_TRUE((CMNewInstance(broker, nullptr, &status), refused()));
    EXPECT_TRUE((broker->eft->getType(broker, broker, &status), refused()));
    EXPECT_EQ(string->ft->release(nullptr).rc, CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(broker->eft->newInstance(nullptr, path("TST_Disk"), nullptr), nullptr);
    EXPECT_EQ((CMNewInstance(broker, path("TST_Unknown"), &status), status.rc), CMPI_RC_ERR_INVALID_CLASS);

    const CMPIValue value{};
    for (const int code : {CMPI_args, CMPI_class, CMPI_filter, CMPI_enumeration, CMPI_ptr, CMPI_charsptr, 0x7777})
        EXPECT_EQ(CMSetProperty(instance, "Name", &value, static_cast<CMPIType>(code)).rc, CMPI_RC_ERR_INVALID_DATA_TYPE) << code;
}

TEST_F(Objects, clones_are_independent_and_outlive_the_request)
{
    CMPIInstance* clone = nullptr;
    {
        const Request inner;
        CMPIInstance* instance = disk();
        CMSetProperty(instance, "Name", "before", CMPI_chars);
        clone = CMClone(instance, nullptr);
        CMSetProperty(instance, "Name", "after", CMPI_chars);
    }
    EXPECT_EQ(text(get(clone, "Name").value.string), "before");
    EXPECT_EQ(CMRelease(clone).rc, CMPI_RC_OK);
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

TEST_F(Objects, system_services_run_threads_that_meet_at_a_condition)
{
    struct Meeting
    {
        const CMPIBrokerExtFT* services;
        CMPI_MUTEX_TYPE mutex;
        CMPI_COND_TYPE condition;
        bool arrived;
    };
    const CMPIBrokerExtFT* services = broker->xft;
    Meeting meeting{services, services->newMutex(0), services->newCondition(0), false};
    CMPI_THREAD_TYPE thread = services->newThread(
        [](void* parameter) -> CMPI_THREAD_RETURN
        {
            auto& m = *static_cast<Meeting*>(parameter);
            m.services->lockMutex(m.mutex);
            m.arrived = true;
            m.services->signalCondition(m.condition);
            m.services->unlockMutex(m.mutex);
            m.services->exitThread(parameter);
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
}

} // namespace
} // namespace cimserver
