#include "hxal/records/commands.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <set>

namespace
{

// The record of the event fetch is larger in memory than its number tells, and its group does not follow the IOC's type. Other
// numbers are held to what operations send.
TEST(Commands, fetch_events_under_one_number)
{
    const auto fetch = std::ranges::find(hxal::catalogue, std::string_view("IOCMD_AEN_GET"), &hxal::Command::name);
    ASSERT_NE(fetch, hxal::catalogue.end());
    EXPECT_EQ(command_code(*fetch, fetch->family.fc), 0xC0584329u);
    EXPECT_EQ(command_code(*fetch, fetch->family.ll), 0xC0584329u);
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
