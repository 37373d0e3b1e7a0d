// The helpers that take the file's lines apart, as C callers see them: what of it no line of a file shows.
#include "config_fixture.h"

#include <climits>
#include <cstring>

namespace
{

TEST(Config_Syntax, filters_both_ends_of_a_text)
{
    const std::pair<const char*, const char*> rows[] = {
        {" \t\"Blue\";\n", "Blue"}, {"a \"b\"; c", "a \"b\"; c"}, {" \";\n\t", " "}, {nullptr, " "}, {"\r\n", "\r"},
    };
    for (const auto& [in, filtered] : rows)
    {
        char out[32];
        hxal_config_filter_space(in, out);
        EXPECT_STREQ(out, filtered) << (in ? in : "null");
    }
    char text[] = "  in place;";
    hxal_config_filter_space(text, text);
    EXPECT_STREQ(text, "in place");
}

TEST(Config_Syntax, leaves_key_and_value_alone_where_there_is_none)
{
    for (const char* line : {"hxa3-key", static_cast<const char*>(nullptr)})
    {
        char tmp[32], key[32] = "untouched", value[32] = "untouched";
        hxal_config_get_key('-', '=', line, tmp, key);
        hxal_config_get_data('=', line, tmp, value);
        EXPECT_EQ(std::string(key) + value, "untoucheduntouched");
    }
}

TEST(Config_Syntax, converts_numbers_lists_and_wwns)
{
    // clang-format off
    const std::pair<const char*, int> decimals[] = {
        {"hxa12", 12}, {"abc", 0}, {nullptr, -1}, {"1\n2", 12}, {"-5", 5}, {"12 ", 0}, {"2147483648", INT_MAX},
        {"10000000000000000000001", INT_MAX}, {"00000000000000000000000008", 8},
    };
    // clang-format on
    for (const auto& [text, value] : decimals)
        EXPECT_EQ(hxal_config_get_num(text), value) << (text ? text : "null");
    for (const auto& [text, value] : {std::pair{"0x1f", 0x1Fu}, {"1F", 0x1Fu}, {"1g", 0x10u}, {"123456789", 0x23456789u}})
        EXPECT_EQ(xstrtoi(text), value) << text;
    EXPECT_EQ(xstrtoi(nullptr) + xtod('g') + xtod('\0'), 0u);
    EXPECT_EQ(HextoDec("0f", 0xA), 0xA0Fu);

    const int list[] = {0, 31, 33, 2};
    EXPECT_EQ(listtobmp(list, 4), 0x80000007u);
    int positions[3] = {-1, -1, -1};
    EXPECT_EQ(bmptolist(0xFFu, positions, 2), 2);
    EXPECT_EQ(positions[2], -1);
    EXPECT_EQ(wwn_convert("1:2:3:4:5:6:7:1ff:9"), wwn_convert("01:02:03:04:05:06:07:FF"));
    EXPECT_EQ(wwn_convert(nullptr), 0u);
}

} // namespace
