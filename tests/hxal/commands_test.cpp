#include "hxal/records/commands.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <set>

namespace
{

// The codes that no row of the operation table sends. The record of the event fetch is larger in memory than its code tells, and
// its group does not follow the IOC's type.
TEST(Commands, have_the_codes_that_the_drivers_know)
{
    struct Code
    {
        std::string_view name;
        std::uint32_t fc;
        std::uint32_t ll;
    };
    constexpr Code codes[] = {
        {"IOCMD_IOC_GET_VERSION", 0xC0084301, 0xC0084401},
        {"IOCMD_IOC_GET_INST", 0xC0284302, 0xC0284402},
        {"IOCMD_IOC_ENABLE", 0xC0084303, 0xC0084403},
        {"IOCMD_IOC_DISABLE", 0xC0084304, 0xC0084404},
        {"IOCMD_IOC_SET_ADAPTER_NAME", 0xC048430C, 0xC048440C},
        {"IOCMD_AEN_GET", 0xC0584329, 0xC0584329},
        {"IOCMD_AEN_SYNC", 0xC058432A, 0xC058442A},
        {"IOCMD_PORT_GET_STATS", 0xC018432E, 0xC018442E},
        {"IOCMD_LPORT_GET_STATS", 0xC0C0B102, 0xC0C0B102},
        {"IOCMD_FLASH_UPDATE_PART", 0xC018B503, 0xC018B503},
        {"IOCMD_FLASH_READ_PART", 0xC018B504, 0xC018B504},
        {"IOCMD_ITNIM_GET_ATTR", 0xC038BB01, 0xC038BB01},
        {"IOCMD_FCOE_GET_STATS", 0xC170C101, 0xC1704401},
    };
    for (const Code& code : codes)
    {
        const auto command = std::ranges::find(hxal::catalogue, code.name, &hxal::Command::name);
        ASSERT_NE(command, hxal::catalogue.end()) << code.name;
        EXPECT_EQ(command_code(*command, command->family.fc), code.fc) << code.name;
        EXPECT_EQ(command_code(*command, command->family.ll), code.ll) << code.name;
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
