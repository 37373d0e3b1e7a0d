// What is read out of bytes that cards, modules and disks deliver: each row is one good or damaged block and what comes of it.
#include "inventory/fru_number.h"
#include "inventory/port_statistics.h"
#include "inventory/scsi_pages.h"
#include "inventory/sfp_info.h"

#include <cstring>
#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace
{

using namespace zmlr;

// Vital product data with one keyword behind the header, and a checksum that fits.
hxa_mfg_vpd_t vpd_with(const std::string& keyword, const std::string& value)
{
    hxa_mfg_vpd_t vpd{};
    std::string data(153, '\0');
    data[0] = '\x82';
    data[131] = '\x90';
    data.replace(134, 2, "V0");
    data += keyword + static_cast<char>(value.size()) + value;
    data += std::string("RV\x01", 3);
    data[132] = static_cast<char>(data.size() + 1 - 153);
    unsigned char sum = 0;
    for (const char byte : data)
        sum = static_cast<unsigned char>(sum + byte);
    data += static_cast<char>(-sum);
    std::memcpy(vpd.data, data.data(), data.size());
    return vpd;
}

const std::string fru_value = "FRU NUMBER         42D0510";

TEST(FRU_number, comes_out_of_a_whole_block_only)
{
    struct Row
    {
        const char* what;
        hxa_mfg_vpd_t vpd;
        const char* fru;
    };
    const auto changed = [](int position, int byte, hxa_mfg_vpd_t vpd = vpd_with("V1", fru_value))
    {
        vpd.data[position] = static_cast<unsigned char>(byte);
        return vpd;
    };
    hxa_mfg_vpd_t plain{};
    plain.vendor = 1;
    std::memset(plain.data + 112, 'P', sizeof plain.data - 112); // without a terminator
    hxa_mfg_vpd_t longest = vpd_with("V1", fru_value);           // its section ends far beyond the block; the sum is made to fit
    longest.data[1] = static_cast<unsigned char>(longest.data[132] + 2);
    longest.data[132] = longest.data[133] = 0xFF;
    hxa_mfg_vpd_t unending = {};
    std::memset(unending.data, 'V', sizeof unending.data);

    const Row rows[] = {
        {"whole", vpd_with("V1", fru_value), "42D0510"},
        {"16 characters at most", vpd_with("VZ", " A FRU NUMBER      0123456789ABCDEFG"), "0123456789ABCDEF"},
        {"shorter than its label", vpd_with("V1", "FRU"), ""},
        {"another keyword", vpd_with("S1", fru_value), ""},
        {"a keyword of no letters", vpd_with("V-", fru_value), ""},
        {"a length beyond the block", longest, "42D0510"},
        {"another value", vpd_with("V1", "PART NUMBER        42D0510"), ""},
        {"checksum", changed(5, 1), ""},
        {"identifier string tag", changed(0, 0x83, changed(1, 0xFF)), ""},
        {"section tag", changed(131, 0x91, changed(1, 0xFF)), ""},
        {"header", changed(134, 'W', changed(1, 0xFF)), ""},
        {"checksum keyword that begins with the section's last byte", changed(132, 30, changed(1, 3)), "42D0510"},
        {"checksum keyword behind the section", changed(132, 29, changed(1, 4)), ""},
        {"nothing but Vs", unending, ""},
        {"nothing", hxa_mfg_vpd_t{}, ""},
    };
    for (const Row& row : rows)
        EXPECT_STREQ(getFRUNumber(row.vpd).c_str(), row.fru) << row.what;
    EXPECT_EQ(std::string(400, 'P'), getFRUNumber(plain).c_str());
}

TEST(Module_memory, tells_what_the_module_is)
{
    struct Row
    {
        unsigned char identifier, ethernet, fc;
        bool is_cna;
        const char *kind, *media;
    };
    constexpr Row rows[] = {
        {1, 0x10, 0xFF, true, "GBIC", "10G_BASE-SR"},
        {3, 0x00, 0x54, false, "SFP", "200,400,800"},
        {3, 0xFF, 0xD5, false, "SFP", "100,200,400,800,1200"},
        {4, 0xF0, 0x00, true, "Unknown", "10G_BASE-SR10G_BASE-LR10G_BASE-"}, // cut
        {0, 0x8F, 0x00, true, "Unknown", ""},
    };
    for (const Row& row : rows)
    {
        sfp_mem_t memory{};
        memory.serial_id_base.identifier = row.identifier;
        memory.serial_id_base.xcvr[0] = row.ethernet;
        memory.serial_id_base.xcvr[7] = row.fc;
        std::memset(memory.serial_id_base.vendor_name, 'N', sizeof memory.serial_id_base.vendor_name); // fills its field
        std::memcpy(memory.serial_id_ext.vendor_sn, "  ABC_123       ", 16);
        const _sfpInfo info = sfp_info(memory, row.is_cna, 2, 1);
        EXPECT_STREQ(info.kind, row.kind);
        EXPECT_STREQ(info.media, row.media);
        EXPECT_STREQ(info.tag, "ABC_123_2_1");
        EXPECT_EQ(std::string(16, 'N'), info.vendor_name);
    }
}

TEST(Identification_page, gives_the_first_designator)
{
    struct Row
    {
        unsigned char code_set, type, length;
        bool used;
        std::string identifier;
    };
    const std::string bytes = "0123456789abcdefghijklmnopqrstuv"; // all 32 that the page has room for
    std::string digits;
    for (char byte : bytes)
    {
        char two[3];
        std::snprintf(two, sizeof two, "%02X", static_cast<unsigned>(byte));
        digits += two;
    }
    const Row rows[] = {
        {1, 3, 16, true, digits.substr(0, 32)},
        {0xF1, 0xF2, 8, true, digits.substr(0, 16)}, // the upper halves mean something else
        {1, 1, 255, true, digits},
        {2, 1, 255, true, bytes},
        {2, 8, 0, true, ""},
        {1, 0, 8, false, ""},
        {1, 4, 8, false, ""},
    };
    for (const Row& row : rows)
    {
        Identification_Page page = {0, 0x83, 0, 36, row.code_set, row.type, 0, row.length};
        std::memcpy(page.data() + 8, bytes.data(), bytes.size());
        _hbaLunInfo info;
        EXPECT_EQ(fill_identifier(info, page), row.used);
        EXPECT_EQ(row.identifier, info.identifier) << int{row.type};
        EXPECT_EQ(info.identifier_type, row.used ? row.type & 0x0FU : 0U);
    }
}

TEST(Scsi_answers, are_read_within_their_bounds)
{
    Serial_Page page{};
    page.fill('S');
    page[3] = 255;
    _hbaLunInfo info;
    fill_serial_number(info, page);
    EXPECT_EQ(std::string(32, 'S'), info.serial_number);

    EXPECT_TRUE(is_tape_device({0x28})) << "a changer, which is not connected";
    EXPECT_EQ(lun_number(std::array<std::uint8_t, 8>{0x40, 0x05}), 5U);
    EXPECT_EQ(lun_number(std::array<std::uint8_t, 8>{0x01, 0x02}), 258U);
    EXPECT_EQ(lun_count(std::vector<std::uint8_t>{0xFF, 0xFF, 0xFF, 0xFF}), 0x1FFFFFFFU);
    EXPECT_EQ(lun_room(816), 101U);
}

TEST(Port_statistics, take_the_first_counter_of_a_name)
{
    const std::vector<hxal_stats_long_t> list = {
        {"Rx frames", 1}, {"Rx frames with bad EOF", 2}, {"Tx words and more", 3}, {"", 4}};
    EXPECT_EQ(fc_port_statistics(list).fc.rx_frames, 1U);
    EXPECT_EQ(fc_port_statistics(list).fc.tx_words, 3U);
    EXPECT_EQ(fc_port_statistics(list).fc.tx_frames, 0U);
}

} // namespace
