#include "hxal/hxal.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <climits>

TEST(Texts, of_statuses_end_in_a_blank_and_cover_0_to_158)
{
    EXPECT_STREQ(hxal_status_to_string(0), "Success ");
    EXPECT_STREQ(hxal_status_to_string(HXA_STATUS_VERSION_FAIL), "Application/Driver version mismatch ");
    EXPECT_STREQ(hxal_status_to_string(HXA_STATUS_NO_DRIVER), "Zemlar adapter/driver not installed or loaded ");
    EXPECT_STREQ(hxal_status_to_string(158), "Invalid switch vendor ");
    for (int code = 0; code < HXA_STATUS_MAX_VAL; ++code)
        EXPECT_EQ(std::string(hxal_status_to_string(code)).back(), ' ') << code;
    for (int code : {159, 160, -1, INT_MAX, INT_MIN})
        EXPECT_STREQ(hxal_status_to_string(code), "Unknown Failure") << code;
}

TEST(Texts, of_values_are_known_up_to_the_last_of_the_table_and_not_behind_it)
{
    struct Row
    {
        const char* (*function)(uint32_t);
        uint32_t last;
        const char* text; // of the last value
        const char* other = "unknown";
    };
    // clang-format off
    const Row rows[] = {
        {hxal_flash_status_to_string,        5,  "badcksum"},
        {hxal_flash_part_type_to_string,     11, "bootovl"},
        {hxal_pm_ds_to_string,               3,  "off"},
        {hxal_ioc_state_to_string,           10, "firmware mismatch"},
        {hxal_pport_states_to_string,        14, "Invalid"},
        {hxal_port_get_state_name,           13, "Disabled#", "Unknown"},
        {hxal_pport_speed_to_string,         15, "Auto"},
        {hxal_pport_type_to_string,          22, "VP"},
        {hxal_pport_topology_to_string,      3,  "Auto"},
        {hxal_rport_state_to_string,         9,  "nsdisc"},
        {hxal_itnim_state_to_string,         7,  "initiator"},
        {hxal_auth_status_to_string,         8,  "failed"},
        {hxal_auth_rej_code_to_string,       2,  "Logical err"},
        {hxal_auth_rej_code_exp_to_string,   10, "Proto Ver."},
        {hxal_vport_state_to_string,         9,  "Error"},
        {hxal_log_severity_to_string,        4,  "Info"},
        {hxal_qos_state_to_string,           2,  "Offline"},
        {hxal_qos_priority_to_string,        3,  "Low"},
        {hxal_pport_linkstate_rsn_to_string, 38, "Physical link down"},
        {hxal_ethport_cee_state_to_string,   2,  "Linkup"},
        {hxal_get_sfp_media,                 5,  "us", "--"},
    };
    // clang-format on
    for (const Row& row : rows)
    {
        EXPECT_STREQ(row.function(row.last), row.text);
        EXPECT_STREQ(row.function(row.last + 1), row.other) << row.text;
        EXPECT_STREQ(row.function(UINT32_MAX), row.other) << row.text;
    }
    EXPECT_STREQ(hxal_pport_speed_to_string(1), "1G ");
    EXPECT_STREQ(hxal_pport_speed_to_string(3), "unknown") << "a gap";
}

TEST(Texts, of_the_port_log)
{
    EXPECT_STREQ(hxa_plog_mid_strings(0), "Invalid");
    EXPECT_STREQ(hxa_plog_mid_strings(8), "Max");
    EXPECT_STREQ(hxa_plog_eid_strings(7), "Tx_Ack1");
    EXPECT_STREQ(hxa_plog_eid_strings(23), "logout");
    for (int index : {-1, 24, 25, INT_MAX})
        EXPECT_STREQ(hxa_plog_eid_strings(index), "") << index;
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
