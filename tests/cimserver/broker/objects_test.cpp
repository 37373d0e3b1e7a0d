// The broker's objects as a provider sees them: through their function tables.
#include "cimserver/broker/broker.h"
#include "cimserver/broker/cmpi_values.h"
#include "cimserver/broker/request.h"
#include "cimserver/broker/return_code.h"
#include "schema/TST_Thing.h"

#include <cmpimacs.h>
#include <gtest/gtest.h>

namespace cimserver
{
namespace
{

constexpr zmlr::Registration things = {"test_Module", "TST_Thing_Provider", nullptr, &zmlr::TST_Thing::static_meta_class,
                                       nullptr};

constexpr CMPIType array(CMPIType type) { return static_cast<CMPIType>(type | CMPI_ARRAY); }

class Objects : public ::testing::Test
{
protected:
    CMPIObjectPath* path(const char* class_name) { return CMNewObjectPath(broker, "root/zemlar", class_name, nullptr); }
    CMPIInstance* thing() { return CMNewInstance(broker, path("TST_Thing"), nullptr); }

    static std::string text(const CMPIString* string) { return CMGetCharsPtr(string, nullptr); }

    static CMPIData get(const CMPIInstance* instance, const char* name) { return CMGetProperty(instance, name, nullptr); }

    Repository repository{&things};
    Broker owner{repository};
    const CMPIBroker* broker = owner.face();
    Request request;
};

TEST_F(Objects, arrays_hold_their_element_type_and_nothing_else)
{
    CMPIArray* strings = CMNewArray(broker, 2, CMPI_chars, nullptr);
    const CMPIUint16 number = 7;
    EXPECT_EQ(CMSetArrayElementAt(strings, 0, "first", CMPI_chars).rc, CMPI_RC_OK);
    EXPECT_EQ(CMSetArrayElementAt(strings, 1, &number, CMPI_uint16).rc, CMPI_RC_ERR_TYPE_MISMATCH);
    EXPECT_EQ(CMSetArrayElementAt(strings, 2, "third", CMPI_chars).rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);

    CMPIInstance* instance = thing();
    EXPECT_EQ(CMSetProperty(instance, "Uint8Values", &strings, array(CMPI_string)).rc, CMPI_RC_ERR_TYPE_MISMATCH);
    EXPECT_EQ(CMSetProperty(instance, "Uint8Values", &strings, array(CMPI_uint8)).rc, CMPI_RC_ERR_TYPE_MISMATCH);
    EXPECT_EQ(CMSetProperty(instance, "StringValues", &strings, array(CMPI_string)).rc, CMPI_RC_OK);
    CMSetArrayElementAt(strings, 0, "changed later", CMPI_chars);
    const CMPIArray* back = get(instance, "StringValues").value.array;
    EXPECT_EQ(text(CMGetArrayElementAt(back, 0, nullptr).value.string), "first");
    EXPECT_EQ(CMGetArrayElementAt(back, 1, nullptr).state, CMPI_nullValue);

    CMPIStatus status{};
    EXPECT_EQ((CMNewArray(broker, 0, array(CMPI_uint8), &status), status.rc), CMPI_RC_ERR_INVALID_DATA_TYPE);
    EXPECT_EQ((CMNewArray(broker, UINT32_MAX, CMPI_uint8, &status), status.rc), CMPI_RC_ERR_INVALID_PARAMETER);
}

TEST_F(Objects, a_property_filter_hides_all_but_the_listed_properties_and_the_keys)
{
    CMPIInstance* instance = thing();
    const char* properties[] = {"uint8value", "NoSuchProperty", nullptr};
    EXPECT_EQ(CMGetPropertyCount(instance, nullptr), 21U);
    EXPECT_EQ(CMSetPropertyFilter(instance, properties, nullptr).rc, CMPI_RC_OK);
    EXPECT_EQ(CMGetPropertyCount(instance, nullptr), 2U);
    CMPIString* second = nullptr;
    CMGetPropertyAt(instance, 1, &second, nullptr);
    EXPECT_EQ(text(second), "Uint8Value");
    EXPECT_EQ(CMSetProperty(instance, "Caption", "hidden", CMPI_chars).rc, CMPI_RC_OK);
    EXPECT_EQ(CMSetProperty(instance, "NoSuchProperty", "x", CMPI_chars).rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    CMPIStatus status{};
    EXPECT_EQ((CMGetProperty(instance, "Caption", &status), status.rc), CMPI_RC_ERR_NO_SUCH_PROPERTY);
    EXPECT_EQ(CMSetPropertyFilter(instance, nullptr, nullptr).rc, CMPI_RC_OK);
    EXPECT_EQ(get(instance, "Caption").state, CMPI_nullValue) << "what is set while it is hidden is dropped";
    EXPECT_EQ(CMSetProperty(instance, "Caption", nullptr, CMPI_null).rc, CMPI_RC_OK);
    EXPECT_EQ(get(instance, "Caption").type, CMPI_string) << "also when it is null";
}

TEST_F(Objects, broken_handles_and_types_that_no_value_has_are_refused)
{
    CMPIStatus status{};
    const auto refused = [&] { return std::exchange(status.rc, CMPI_RC_OK) == CMPI_RC_ERR_INVALID_HANDLE; };
    CMPIInstance* instance = thing();
    const CMPIString* string = CMNewString(broker, "x", nullptr);
    EXPECT_TRUE((instance->ft->getProperty(nullptr, "Caption", &status), refused()));
    const CMPIInstance no_object{nullptr, instance->ft};
    EXPECT_TRUE((instance->ft->getPropertyCount(&no_object, &status), refused()));
    EXPECT_TRUE((string->ft->getCharPtr(reinterpret_cast<const CMPIString*>(instance), &status), refused()));
    EXPECT_TRUE((CMNewInstance(broker, nullptr, &status), refused()));
    EXPECT_EQ(string->ft->release(nullptr).rc, CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(broker->eft->newInstance(nullptr, path("TST_Thing"), nullptr), nullptr);
    EXPECT_EQ((CMNewInstance(broker, path("TST_Unknown"), &status), status.rc), CMPI_RC_ERR_INVALID_CLASS);

    const CMPIValue value{};
    for (const int code : {CMPI_args, CMPI_class, CMPI_filter, CMPI_enumeration, CMPI_ptr, CMPI_charsptr, 0x7777})
        EXPECT_EQ(CMSetProperty(instance, "Caption", &value, static_cast<CMPIType>(code)).rc, CMPI_RC_ERR_INVALID_DATA_TYPE)
            << code;
}

TEST_F(Objects, clones_are_independent_and_outlive_the_request)
{
    const CMPIUint8 number = 7;
    CMPIInstance* clone = nullptr;
    {
        const Request inner;
        CMPIInstance* instance = thing();
        CMSetProperty(instance, "Uint8Value", &number, CMPI_uint8);
        CMSetProperty(instance, "Caption", "before", CMPI_chars);
        clone = CMClone(instance, nullptr);
        CMSetProperty(instance, "Caption", "after", CMPI_chars);
        EXPECT_EQ(text(get(instance, "Caption").value.string), "after");
    }
    EXPECT_EQ(get(clone, "Uint8Value").value.uint8, number);
    EXPECT_EQ(text(get(clone, "Caption").value.string), "before");
    EXPECT_EQ(CMRelease(clone).rc, CMPI_RC_OK);
}

// No row of a table is null: a provider of another maker gets an answer.
TEST_F(Objects, what_is_not_offered_says_so)
{
    CMPIStatus status{};
    const auto refused = [&] { return std::exchange(status.rc, CMPI_RC_OK) == CMPI_RC_ERR_NOT_SUPPORTED; };
    EXPECT_TRUE((CBExecQuery(broker, request.context(), path("TST_Thing"), "SELECT * FROM x", "WQL", &status), refused()));
    EXPECT_EQ(CBSetProperty(broker, request.context(), path("TST_Thing"), "Caption", nullptr, CMPI_null).rc,
              CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(CBGetProperty(broker, request.context(), path("TST_Thing"), "Caption", &status).state, CMPI_notFound);
    EXPECT_TRUE(refused());
    EXPECT_EQ(broker->eft->getMessage(broker, "id", "$0", &status, 1, CMPI_sint32, 5), nullptr);
    EXPECT_TRUE(refused());
    EXPECT_NE(broker->xft->joinThread(nullptr, nullptr), 0);
    EXPECT_EQ(broker->xft->newMutex(0), nullptr);
}

// What only modules of another maker answer: the adapter of ours has codes that every server knows.
TEST(Return_Code, of_a_provider_is_a_status_of_the_operation)
{
    for (const auto& [code, status] : {std::pair(1, 1), {7, 7}, {17, 17}, {18, 1}, {50, 1}, {255, 1}})
        EXPECT_EQ(cim_status(static_cast<CMPIrc>(code)), status) << code;
    EXPECT_EQ(outcome_text("TST_Thing", "GetInstance", CMPI_RC_DO_NOT_UNLOAD), "TST_Thing: GetInstance failed with code 50");
}

} // namespace
} // namespace cimserver
