// The helpers that take the file's texts apart.
#include "config_fixture.h"

#include <climits>
#include <cstring>

namespace
{

TEST(Config_Text, is_filtered_at_both_ends)
{
    const std::pair<const char*, const char*> rows[] = {
        {" \t\"Blue\";\n", "Blue"}, {"a \"b\"; c", "a \"b\"; c"}, {"", " "}, {" \";\n\t", " "}, {nullptr, " "}, {"\r\n", "\r"},
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

TEST(Config_Text, has_key_and_value)
{
    struct Row
    {
        char start;
        const char* line;
        const char* key;
        const char* value;
    };
    const char* const untouched = "untouched";
    const Row rows[] = {
        {'-', "hxa3-port-speed = 8;", "port-speed", "8"},
        {'\0', "port-speed = 4;", "port-speed", "4"},
        {'-', "a=hxa3- x =4", "x", "hxa3- x =4"},
        {'-', "port = 4", untouched, "4"},
        {'-', "hxa3-=4", untouched, "4"},
        {'\0', "=", untouched, " "},
        {'\0', " =", " ", " "},
        {'-', "hxa3-key", untouched, untouched},
        {'-', nullptr, untouched, untouched},
    };
    for (const Row& row : rows)
    {
        char tmp[32];
        char key[32] = "untouched";
        char value[32] = "untouched";
        hxal_config_get_key(row.start, '=', row.line, tmp, key);
        hxal_config_get_data('=', row.line, tmp, value);
        EXPECT_STREQ(key, row.key) << row.line;
        EXPECT_STREQ(value, row.value) << row.line;
    }
}

TEST(Config_Text, converts_to_numbers)
{
    // clang-format off
    const std::pair<const char*, int> decimals[] = {
        {"hxa12", 12}, {"abc", 0}, {"", 0}, {nullptr, -1}, {"12\n", 12}, {"1\n2", 12}, {"-5", 5}, {"12 ", 0}, {"007", 7},
        {"2147483647", INT_MAX}, {"2147483648", INT_MAX}, {"10000000000000000000001", INT_MAX},
        {"00000000000000000000000008", 8},
    };
    // clang-format on
    for (const auto& [text, value] : decimals)
        EXPECT_EQ(hxal_config_get_num(text), value) << (text ? text : "null");

    const std::pair<const char*, unsigned> hexadecimals[] = {
        {"0x1f", 0x1F}, {"1F", 0x1F}, {"g1", 1}, {"1g", 0x10}, {"", 0}, {nullptr, 0}, {"123456789", 0x23456789},
    };
    for (const auto& [text, value] : hexadecimals)
        EXPECT_EQ(xstrtoi(text), value) << (text ? text : "null");
    EXPECT_EQ(xtod('f') + xtod('A') + xtod('9') + xtod('g') + xtod('\0'), 15u + 10u + 9u);
    EXPECT_EQ(HextoDec("0f", 0xA), 0xA0Fu);
}

TEST(Config_Text, converts_to_bitmaps_and_back)
{
    const int list[] = {0, 31, 33, 2};
    EXPECT_EQ(listtobmp(list, 4), 0x80000007u);
    EXPECT_EQ(listtobmp(list, 0), 0u);
    int positions[3] = {-1, -1, -1};
    EXPECT_EQ(bmptolist(0x80000005u, positions, 3), 3);
    EXPECT_EQ(positions[2], 31);
    EXPECT_EQ(bmptolist(0xFFu, positions, 2), 2);
    EXPECT_EQ(positions[2], 31);
}

TEST(Config_Text, converts_to_wwns)
{
    const std::pair<const char*, std::vector<uint8_t>> rows[] = {
        {"10:00:00:05:1e:10:AB:cd", {0x10, 0, 0, 5, 0x1E, 0x10, 0xAB, 0xCD}},
        {"1:2:3:4:5:6:7:8:9", {1, 2, 3, 4, 5, 6, 7, 8}},
        {":1::2", {1, 2, 0, 0, 0, 0, 0, 0}},
        {"1ff", {0xFF, 0, 0, 0, 0, 0, 0, 0}},
        {"", {0, 0, 0, 0, 0, 0, 0, 0}},
        {nullptr, {0, 0, 0, 0, 0, 0, 0, 0}},
    };
    for (const auto& [text, bytes] : rows)
    {
        const wwn_t wwn = wwn_convert(text);
        EXPECT_EQ(std::memcmp(&wwn, bytes.data(), sizeof wwn), 0) << (text ? text : "null");
    }
}

TEST(Config_Text, comes_in_lines_that_fit_the_buffer)
{
    const std::unique_ptr<std::FILE, decltype(&std::fclose)> file(std::tmpfile(), std::fclose);
    std::fwrite("ab\n\0\nabcdefg\nend", 1, 16, file.get());
    std::rewind(file.get());
    char line[6];
    for (const std::string& expected : {std::string("ab\n"), std::string("\0\n", 2), std::string("abcde"), std::string("fg\n"),
                                        std::string("end"), std::string()})
    {
        const int length = hxal_getline(line, sizeof line, file.get());
        EXPECT_EQ(std::string(line, static_cast<std::size_t>(length)), expected);
        EXPECT_EQ(line[length], '\0');
    }
}

} // namespace
