#include "inventory/address_text.h"
#include "inventory/class_id.h"
#include "inventory/property_text.h"
#include "inventory/provider_util.h"

#include <gmock/gmock.h>

#include <cstring>
#include <string>

using namespace zmlr;
using testing::ElementsAre;
using testing::ElementsAreArray;

TEST(Class_Names, table_and_its_ends)
{
    const std::pair<uint32, const char*> cases[] = {
        {0, "--"}, {3, "ZEMLAR_FCPort"}, {36, "ZEMLAR_AlarmDevice"}, {37, "INVALID CLASS"}, {0xFFFFFFFF, "INVALID CLASS"}};
    for (const auto& [id, name] : cases)
        EXPECT_STREQ(ProviderUtil::getClassName(static_cast<classId_t>(id)).c_str(), name);
}

TEST(Address_Text, in_memory_order_and_strict)
{
    const unsigned char bytes[] = {0x20, 0x00, 0x00, 0x05, 0x1e, 0xab, 0x0f, 0xf0};
    wwn_t wwn;
    std::memcpy(&wwn, bytes, sizeof wwn);
    char wwn_text[ProviderUtil::wwn_text_size];
    ProviderUtil::WWN2str(wwn_text, &wwn);
    EXPECT_STREQ(wwn_text, "200000051EAB0FF0");
    unsigned char raw_wwn[8];
    EXPECT_TRUE(ProviderUtil::getRawWWNFromStr("200000051eAB0fF0", raw_wwn));
    EXPECT_THAT(raw_wwn, ElementsAreArray(bytes));

    mac_t address = {{0x00, 0x05, 0x1e, 0xab, 0x0f, 0xf0}};
    char mac_text[ProviderUtil::mac_text_size];
    ProviderUtil::MAC2str(mac_text, &address);
    EXPECT_STREQ(mac_text, "00051EAB0FF0");
    unsigned char mac[6];
    EXPECT_TRUE(ProviderUtil::getRawMacFromStr(mac_text, mac));
    EXPECT_EQ(std::memcmp(mac, &address, sizeof mac), 0);
    for (const char* text :
         {"", "0", "00051EAB0FF", "00051EAB0FFG", "00051E AB0FF", "-0051EAB0FF0", "0x051EAB0FF0", "00051EAB0F@0"})
    {
        std::memset(mac, 0xEE, sizeof mac);
        EXPECT_FALSE(ProviderUtil::getRawMacFromStr(text, mac)) << text;
        EXPECT_THAT(mac, ElementsAre(0, 0, 0, 0, 0, 0)) << text;
    }
}

TEST(Address_Text, trimmed_of_blanks_only)
{
    constexpr const char* cases[][2] = {
        {"  2.1.3.0  ", "2.1.3.0"}, {"2.1 3", "2.1 3"}, {"   ", ""}, {"", ""}, {" \t x\n ", "\t x\n"},
    };
    for (const auto& [in, expected] : cases)
    {
        char out[32];
        ProviderUtil::trimString(in, out);
        EXPECT_STREQ(out, expected) << '"' << in << '"';
        std::strcpy(out, in);
        ProviderUtil::trimString(out, out);
        EXPECT_STREQ(out, expected) << '"' << in << "\" in place";
    }
}

TEST(Address_Text, taken_from_a_package_tag)
{
    constexpr const char* cna = "10000000-0000-0000-0000-00051E200000";
    constexpr const char* hba = "10000000-0000-0000-2000-00051E123456";
    constexpr const char* cases[][3] = {
        // clang-format off
        {cna, "Zemlar-C10", "00051E200000"}, {cna, "zemlar-c20", "00051E200000"}, {cna, "Zemlar-C07", "00051E200000"},
        {hba, "Zemlar-F15", "200000051E123456"}, {hba, "ZEMLAR-F25", "200000051E123456"},
        {hba, "Zemlar-F85", "200000051E123456"}, {hba, "Zemlar-F86", "200000051E123456"},
        {hba, "Zemlar-F99", ""}, {hba, "", ""}, {hba, "Zemlar-F8", ""},
        {"10000000", "Zemlar-C10", ""}, {"10000000-0000-0000-20", "Zemlar-F85", "20"}, {"", "Zemlar-F85", ""},
        // clang-format on
    };
    for (const auto& [tag, model, expected] : cases)
        EXPECT_STREQ(ProviderUtil::getNodeMACOrWWNFromTag(tag, model).c_str(), expected) << tag << ' ' << model;
}

TEST(Property_Text, holds_only_what_xml_can_carry)
{
    using namespace std::string_literals;
    const std::pair<std::string, std::string> cases[] = {
        {"Zemlar-F86 port 0", "Zemlar-F86 port 0"},
        {"ends\0here"s, "ends"},
        {"tab\tlf\ncr\r", "tab\tlf\ncr\r"},
        {"\x01\x1F\x7F", "??\x7F"},
        {"caf\xC3\xA9 \xE2\x82\xAC \xF0\x9F\x98\x80", "caf\xC3\xA9 \xE2\x82\xAC \xF0\x9F\x98\x80"},
        {"\x80\xBF\xFE\xFF\xF5", "?????"},
        {"\xC0\x80\xC1\xBF", "????"}, // too long for their code points
        {"\xE0\x9F\xBF\xF0\x8F\xBF\xBF", "???????"},
        {"\xED\xA0\x80|\xED\x9F\xBF", "???|\xED\x9F\xBF"}, // the first surrogate, and the code point below
        {"\xEF\xBF\xBD|\xEF\xBF\xBE|\xEF\xBF\xBF", "\xEF\xBF\xBD|???|???"},
        {"\xF4\x8F\xBF\xBF|\xF4\x90\x80\x80", "\xF4\x8F\xBF\xBF|????"},
        {"cut \xE2\x82", "cut ??"},
        {"\xE2\x82zz\xC3", "??zz?"},
    };
    for (const auto& [field, expected] : cases)
        EXPECT_EQ(property_text(field.data(), field.size()).c_str(), expected);

    const char unterminated[4] = {'a', 'b', '\xC3', '\xA9'};
    EXPECT_STREQ(property_text(unterminated).c_str(), "ab\xC3\xA9");
}

TEST(Property_Text, copies_are_cut_and_terminated)
{
    const char unterminated[4] = {'a', 'b', 'c', 'd'};
    char same[4];
    copy_text(same, unterminated);
    EXPECT_STREQ(same, "abc");
    char larger[8];
    copy_text(larger, unterminated);
    EXPECT_STREQ(larger, "abcd");
}
