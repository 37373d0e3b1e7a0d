#include "hxal/records/commands.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <map>
#include <set>

namespace
{

TEST(Commands, have_the_group_byte_of_their_family_and_their_record_size_in_the_code)
{
    struct Codes
    {
        std::uint32_t fc, ll;
    };
    const std::map<std::string_view, Codes> expected = {
        {"IOCMD_IOC_GET_ATTR", {0xC6484306, 0xC6484406}},      {"IOCMD_IOC_ENABLE", {0xC0084303, 0xC0084403}},
        {"IOCMD_AEN_GET", {0xC0584329, 0xC0584329}},           {"IOCMD_IOCFC_RESET_STATS", {0xC008B003, 0xC0084403}},
        {"IOCMD_LPORT_GET_RPORTS", {0xC020B104, 0xC020B104}},  {"IOCMD_RPORT_GET_ATTR", {0xC158B205, 0xC158B205}},
        {"IOCMD_FLASH_GET_ATTR", {0xC210B501, 0xC210B501}},    {"IOCMD_SCSI_CMND", {0xC050BA01, 0xC050BA01}},
        {"IOCMD_ITNIM_RESET_STATS", {0xC018BB03, 0xC018BB03}}, {"IOCMD_FCOE_GET_STATS", {0xC170C101, 0xC1704401}},
    };
    for (const hxal::Command& command : hxal::catalogue)
        if (const auto row = expected.find(command.name); row != expected.end())
        {
            EXPECT_EQ(command_code(command, command.family.fc), row->second.fc) << command.name;
            EXPECT_EQ(command_code(command, command.family.ll), row->second.ll) << command.name;
        }
}

// On the FC node every code stands for one command. On the Ethernet node two commands share one, which the library tells
// apart before it sends.
TEST(Commands, share_no_code_on_the_fc_node)
{
    std::set<std::string_view> names;
    std::set<std::uint32_t> codes;
    for (const hxal::Command& command : hxal::catalogue)
    {
        EXPECT_TRUE(names.insert(command.name).second) << command.name;
        EXPECT_TRUE(codes.insert(command_code(command, command.family.fc)).second) << command.name;
    }
    EXPECT_EQ(names.size(), 72u);
}

} // namespace
