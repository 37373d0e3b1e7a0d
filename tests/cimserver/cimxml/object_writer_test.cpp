// Golden texts of values, paths and instances, and what becomes of bytes and values that clients refuse.
#include "cimserver/cimxml/object_writer.h"
#include "cimserver/model/value_text.h"
#include "tests/support/temporary_folder.h"

#include <gtest/gtest.h>

#include <cmath>
#include <tuple>

using namespace cimserver;

namespace
{

std::string escaped(std::string_view text)
{
    Xml_Writer writer;
    return writer.text(text).take();
}

constexpr std::uint64_t operator""_u(unsigned long long number) { return number; }

Object_Path path_to(const std::string& host, const std::string& name_space)
{
    return {host, name_space, "A", {{"K", {CMPI_string, std::string("1")}}}};
}

} // namespace

TEST(xml_writer, replaces_what_no_document_can_carry)
{
    const std::pair<std::string, std::string> rows[] = {
        {"<a href=\"x\">'&'</a>", "&lt;a href=&quot;x&quot;&gt;&apos;&amp;&apos;&lt;/a&gt;"},
        {std::string("\0\x01\x1F\x7F", 4), "???\x7F"},
        {"\t\r\n", "\t\r\n"},
        {"\xC3\xA9 \xE2\x82\xAC \xF0\x9F\x98\x80 \xF4\x8F\xBF\xBF", "\xC3\xA9 \xE2\x82\xAC \xF0\x9F\x98\x80 \xF4\x8F\xBF\xBF"},
        {"\xC1\x81 \xE0\x81\x81 \xF0\x80\x81\x81", "?? ??? ????"}, // overlong
        {"\xED\xA0\x80 \xED\x9F\xBF", "??? \xED\x9F\xBF"},         // surrogates and the last one before them
        {"\xEF\xBF\xBE \xEF\xBF\xBF \xEF\xBF\xBD", "??? ??? \xEF\xBF\xBD"},
        {"\xF4\x90\x80\x80 \xF5\xFF\xFE", "???? ???"}, // beyond Unicode
        {"a\x80"
         "b\xC3",
         "a?b?"},
        {"\xE2\x82", "??"}, // cut short
        {"\xE2\x28\xA1", "?(?"},
        {"", ""},
    };
    for (const auto& [bytes, text] : rows)
        EXPECT_EQ(escaped(bytes), text);
}

TEST(value_text, writes_what_its_type_can_hold)
{
    const std::tuple<CMPIType, Value::Content, const char*> rows[] = {
        {CMPI_uint8, 256_u, "(null)"},
        {CMPI_sint8, std::int64_t{-129}, "(null)"},
        {CMPI_sint16, std::int64_t{32768}, "(null)"},
        {CMPI_uint32, std::int64_t{-1}, "(null)"},
        {CMPI_real32, 0.1, "0.1"},
        {CMPI_real64, 2.0, "2.0"},
        {CMPI_real64, 1e300, "1.0e+300"},
        {CMPI_real64, std::nan(""), "NaN"},
        {CMPI_real64, -HUGE_VAL, "-INF"},
        {CMPI_char16, 0x1F_u, "(null)"},
        {CMPI_char16, 0xD800_u, "(null)"},
        {CMPI_char16, 0xDFFF_u, "(null)"},
        {CMPI_char16, 0xFFFE_u, "(null)"},
        {CMPI_char16, 0x10000_u, "(null)"},
    };
    for (const auto& [type, content, text] : rows)
        EXPECT_EQ(value_text({type, content}).value_or("(null)"), text) << type;
}

TEST(value_text, passes_only_datetimes_that_clients_read)
{
    for (const char* good : {"20240229235959.123456-300", "00010101000000.000000+999", "99991231235959.999999+000",
                             "00000000000000.000000:000", "99999999235959.999999:000"})
        EXPECT_TRUE(is_readable_datetime(good)) << good;
    for (const char* bad :
         {"", "00000000000000.000000+000", "20230229000000.000000+000", "20241301000000.000000+000", "20240101240000.000000+000",
          "20240101006000.000000+000", "20240101000060.000000+000", "20240101000000.000000+0000", "20240101000000,000000+000",
          "2024010100000a.000000+000", "20240101000000.0000-0+000", "20240101000000.000000*000", "00000000000000.000000:001",
          "00000000240000.000000:000", "20240101000000.000000+-12"})
        EXPECT_FALSE(is_readable_datetime(bad)) << bad;
}

TEST(object_writer, writes_every_kind_of_property)
{
    const auto target = path_to("", "");
    Instance instance;
    instance.path.class_name = "TST_Port";
    instance.properties = {
        {"Name", {CMPI_string, std::string("a b")}},
        {"Status", {CMPI_string, {}}},
        {"Empty", {CMPI_string, std::string()}},
        {"When", {CMPI_dateTime, std::string("00000000000000.000000+000")}},
        {"List", {CMPI_uint16 | CMPI_ARRAY, std::vector<Value>{{CMPI_uint16, 1_u}, {CMPI_uint16, 2_u}}}},
        {"Broken", {CMPI_uint8 | CMPI_ARRAY, std::vector<Value>{{CMPI_uint8, 1_u}, {CMPI_uint8, 999_u}}}},
        {"Texts", {CMPI_string | CMPI_ARRAY, std::vector<Value>{{CMPI_string, std::string("x")}, {CMPI_string, {}}}}},
        {"None", {CMPI_string | CMPI_ARRAY, std::vector<Value>{}}},
        {"Null", {CMPI_string | CMPI_ARRAY, {}}},
        {"Ref", {CMPI_ref, target}},
        {"NoRef", {CMPI_ref, {}}},
        {"Refs", {CMPI_ref | CMPI_ARRAY, std::vector<Value>{}}},
        {"Unknown", {CMPI_null, {}}},
    };
    Xml_Writer writer;
    write_instance(writer, instance);
    std::string expected = Temporary_Folder::content(TEST_TABLES "/cimxml/every_property.xml"); // a property a line
    std::erase(expected, '\n');
    EXPECT_EQ(writer.take(), expected);
}

TEST(object_writer, writes_keys_that_clients_could_refuse_as_texts)
{
    Xml_Writer writer;
    write_instance_name(writer, {"",
                                 "",
                                 "A",
                                 {{"B", {CMPI_boolean, true}},
                                  {"D", {CMPI_dateTime, std::string("bad")}},
                                  {"Big", {CMPI_uint8, 256_u}},
                                  {"Null", {CMPI_string, {}}}}});
    EXPECT_EQ(writer.take(),
              "<INSTANCENAME CLASSNAME=\"A\">"
              "<KEYBINDING NAME=\"B\"><KEYVALUE VALUETYPE=\"boolean\" TYPE=\"boolean\">true</KEYVALUE></KEYBINDING>"
              "<KEYBINDING NAME=\"D\"><KEYVALUE VALUETYPE=\"string\">bad</KEYVALUE></KEYBINDING>"
              "<KEYBINDING NAME=\"Big\"><KEYVALUE VALUETYPE=\"string\"></KEYVALUE></KEYBINDING>"
              "</INSTANCENAME>");
}
