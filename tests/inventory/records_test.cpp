// What needs no host: texts, and the way from the library's records through ours to an instance.
#include "inventory/address_text.h"
#include "inventory/ethernet_port.h"
#include "inventory/fc_port.h"
#include "inventory/port_states.h"
#include "inventory/property_text.h"
#include "tests/inventory/inventory_fixture.h"

#include <cstring>

using namespace zmlr;
using namespace std::string_literals;

TEST(Records, addresses_in_memory_order_and_strict)
{
    unsigned char raw[8];
    EXPECT_TRUE(ProviderUtil::getRawWWNFromStr("200000051eAB0fF0", raw));
    wwn_t wwn;
    std::memcpy(&wwn, raw, sizeof wwn);
    char text[ProviderUtil::wwn_text_size];
    ProviderUtil::WWN2str(text, &wwn);
    EXPECT_STREQ(text, "200000051EAB0FF0");
    EXPECT_EQ(std::memcmp(raw, "\x20\x00\x00\x05\x1e\xab\x0f\xf0", sizeof raw), 0);

    mac_t mac;
    EXPECT_TRUE(ProviderUtil::getRawMacFromStr("00051EAB0ff0", mac.mac));
    ProviderUtil::MAC2str(text, &mac);
    EXPECT_STREQ(text, "00051EAB0FF0");
    for (const char* wrong :
         {"", "0", "00051EAB0FF", "00051EAB0FFG", "00051E AB0FF", "-0051EAB0FF0", "0x051EAB0FF0", "00051EAB0F@0"})
    {
        std::memset(&mac, 0xEE, sizeof mac);
        EXPECT_FALSE(ProviderUtil::getRawMacFromStr(wrong, mac.mac)) << wrong;
        EXPECT_EQ(std::memcmp(&mac, "\0\0\0\0\0\0", sizeof mac), 0) << wrong;
    }
}

TEST(Records, trimmed_texts_and_addresses_from_package_tags)
{
    for (const auto& [in, expected] : {std::pair{"  \t2.1 3\n  ", "\t2.1 3\n"}, {"   ", ""}})
    {
        char text[16];
        std::strcpy(text, in);
        ProviderUtil::trimString(text, text);
        EXPECT_STREQ(text, expected);
    }

    constexpr const char* cna = "10000000-0000-0000-0000-00051E200000";
    constexpr const char* hba = "10000000-0000-0000-2000-00051E123456";
    constexpr const char* cases[][3] = {
        // clang-format off
        {cna, "Zemlar-C10", "00051E200000"},     {cna, "zemlar-c20", "00051E200000"},     {cna, "Zemlar-C07", "00051E200000"},
        {hba, "Zemlar-F15", "200000051E123456"}, {hba, "ZEMLAR-F25", "200000051E123456"}, {hba, "Zemlar-F85", "200000051E123456"},
        {hba, "Zemlar-F86", "200000051E123456"}, {hba, "Zemlar-F99", ""},                 {hba, "Zemlar-F8", ""},
        {"10000000", "Zemlar-C10", ""},          {"10000000-0000-0000-20", "Zemlar-F85", "20"}, {"", "Zemlar-F85", ""},
        // clang-format on
    };
    for (const auto& [tag, model, expected] : cases)
        EXPECT_STREQ(ProviderUtil::getNodeMACOrWWNFromTag(tag, model).c_str(), expected) << tag << ' ' << model;
}

// What of other bytes no XML can carry, the server's writer shows: both call the same function.
TEST(Records, texts_that_end_where_their_field_does)
{
    const std::pair<std::string, std::string> cases[] = {{"ends\0here"s, "ends"},
                                                         {"tab\tlf\ncr\r", "tab\tlf\ncr?"},
                                                         {"\x01 caf\xC3\xA9", "? caf\xC3\xA9"},
                                                         {"cut \xE2\x82", "cut ??"}};
    for (const auto& [field, expected] : cases)
        EXPECT_EQ(property_text(field.data(), field.size()).c_str(), expected);

    constexpr char unterminated[4] = {'a', 'b', 'c', 'd'};
    char copy[4];
    copy_text(copy, unterminated);
    EXPECT_STREQ(copy, "abc");
}

TEST(Records, port_states_and_types_of_the_driver)
{
    constexpr int states[][3] = {{0, 0, 1}, {1, 0, 1},  {2, 8, 9},  {3, 8, 9},  {4, 13, 6}, {5, 11, 2},       {6, 9, 4},
                                 {7, 9, 4}, {8, 10, 3}, {9, 10, 3}, {10, 6, 1}, {11, 0, 1}, {0xFFFFFFF, 0, 1}};
    for (const auto& [driver, operational, enabled] : states)
    {
        EXPECT_EQ(getPortState(static_cast<uint32>(driver)), operational) << driver;
        EXPECT_EQ(getEnabledState(getPortState(static_cast<uint32>(driver))), enabled) << driver;
    }
    constexpr int types[][2] = {{0, 0}, {1, 0}, {2, 10}, {5, 10}, {6, 11}, {7, 0}, {20, 11}, {21, 10}, {22, 10}, {23, 0}};
    for (const auto& [driver, cim] : types)
        EXPECT_EQ(getPortType(static_cast<uint32>(driver)), cim) << driver;
    constexpr std::pair<const char*, int> media[] = {
        {"10G_BASE-SR", 105}, {"10G_BASE-LR", 108}, {"10G_BASE-LRM", 108}, {"10G_BASE-SR10G_BASE-LR", 0}, {"", 0}};
    for (const auto& [text, cim] : media)
        EXPECT_EQ(getEthernetPortType(text), cim) << text;
    constexpr uint16 healths[][2] = {{0, 0}, {6, 15}, {8, 5}, {9, 10}, {10, 10}, {11, 5}, {13, 10}};
    for (const auto& [operational, health] : healths)
        EXPECT_EQ(getLANEndpointInstance({.operational_status = operational})->HealthState.value, health) << operational;
}

TEST(Records, a_port_of_a_driver_that_says_anything)
{
    hxa_pport_attr_t attributes;
    std::memset(&attributes, 0xFF, sizeof attributes);
    std::memset(attributes.port_symname, 0xC3, sizeof attributes.port_symname); // a text without end
    _hbaPortInfo info;
    fill_port(info, attributes, 1);
    const Ref<ZEMLAR_FCPort> port = getFCPortInstance(info);
    const std::pair<const char*, std::string> expected[] = {
        // clang-format off
        {"DeviceID", R"("FFFFFFFFFFFFFFFF")"}, {"Caption", '"' + std::string(255, '?') + '"'},
        {"Speed", "4294967295000000000"}, {"MaxSpeed", "4294967295000000000"}, {"SupportedMaximumTransmissionUnit", "65535"},
        {"OperationalStatus", "{ 0 }"}, {"PortType", "0"}, {"PortNumber", "1"},
        // clang-format on
    };
    for (const auto& [property, value] : expected)
        EXPECT_EQ(value_of(port.ptr(), property), value) << property;
}
