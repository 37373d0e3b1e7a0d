// Every text that stands for a value.
#include "tests/hxal/golden.h"

#include "hxal/hxal.h"

#include <gtest/gtest.h>

#include <climits>

namespace
{

using Text_Of = std::function<const char*(uint32_t)>;

// The texts of 0 and up, then the one of all values behind them.
std::string list(const Text_Of& text_of)
{
    const std::string other = text_of(UINT32_MAX);
    std::string lines;
    for (uint32_t value = 0; value <= HXA_STATUS_MAX_VAL + 2; ++value)
        if (const std::string text = text_of(value); text != other)
            lines += std::to_string(value) + " |" + text + "|\n";
    return lines + "other |" + other + "|\n\n";
}

} // namespace

TEST(Texts, are_known_for_each_value_and_for_all_others)
{
    std::string all = list([](uint32_t code) { return hxal_status_to_string(static_cast<int>(code)); }) +
                      list([](uint32_t index) { return hxa_plog_eid_strings(static_cast<int>(index)); });
    const Text_Of functions[] = {
        hxal_flash_status_to_string,        hxal_flash_part_type_to_string,   hxal_pm_ds_to_string,
        hxal_ioc_state_to_string,           hxal_pport_states_to_string,      hxal_port_get_state_name,
        hxal_pport_speed_to_string,         hxal_pport_type_to_string,        hxal_pport_topology_to_string,
        hxal_rport_state_to_string,         hxal_itnim_state_to_string,       hxal_auth_status_to_string,
        hxal_auth_rej_code_to_string,       hxal_auth_rej_code_exp_to_string, hxal_vport_state_to_string,
        hxal_log_severity_to_string,        hxal_qos_state_to_string,         hxal_qos_priority_to_string,
        hxal_pport_linkstate_rsn_to_string, hxal_ethport_cee_state_to_string, hxal_get_sfp_media};
    for (const Text_Of& function : functions)
        all += list(function);
    EXPECT_EQ(all, golden("texts.txt"));
    EXPECT_STREQ(hxal_status_to_string(INT_MIN), "Unknown Failure");
    EXPECT_STREQ(hxa_plog_mid_strings(0), "Invalid");
    EXPECT_STREQ(hxa_plog_mid_strings(8), "Max");
}

TEST(Checksum, of_bytes_and_of_words)
{
    const uint8_t bytes[] = {1, 2, 3, 0xFF};
    EXPECT_EQ(hxal_checksum_u8(bytes, 3), 0xFAu);
    EXPECT_EQ(hxal_checksum_u8(bytes, 4), 0xFBu);
    EXPECT_EQ(hxal_checksum_u8(nullptr, 0), 0u);

    const uint32_t words[] = {0xF0F0F0F0, 0x0F0F0F0F};
    EXPECT_EQ(hxa_checksum_u32(words, 8), 0xFFFFFFFFu);
    EXPECT_EQ(hxa_checksum_u32(words, 7), 0xF0F0F0F0u);
    EXPECT_EQ(hxa_checksum_u32(words, 3), 0u);
    EXPECT_EQ(hxa_checksum_u32(words, -8), 0u);
}
