#include "runtime/number.h"

#include "runtime/string.h"
#include "tests/support/rows.h"

#include <cstdio>
#include <map>

using namespace zmlr;

namespace
{

template <class T> std::string written(const char* (*write)(char (&)[number_text_size], T, uint32&), T x)
{
    char buffer[number_text_size];
    uint32 size = 0;
    const char* text = write(buffer, x, size);
    EXPECT_EQ(text[size], '\0');
    return std::string(text, size);
}

std::string written(boolean x) { return x ? "true" : "false"; }
std::string written(real64 x)
{
    char text[40];
    std::snprintf(text, sizeof text, "%g", x);
    return text;
}

// What the text is read as, written again.
template <class T, int (*read)(const char*, T&), auto... write> std::string reread(const char* text)
{
    T x{1};
    if (read(text, x) == 0)
        return written(write..., x);
    EXPECT_EQ(x, T{1}) << "changed";
    return "refused";
}

const std::map<std::string, std::string (*)(const char*)> readers = {
    {"uint8", reread<uint8, str_to_uint8, uint8_to_str>},
    {"sint8", reread<sint8, str_to_sint8, sint8_to_str>},
    {"uint16", reread<uint16, str_to_uint16, uint16_to_str>},
    {"sint16", reread<sint16, str_to_sint16, sint16_to_str>},
    {"uint32", reread<uint32, str_to_uint32, uint32_to_str>},
    {"sint32", reread<sint32, str_to_sint32, sint32_to_str>},
    {"uint64", reread<uint64, str_to_uint64, uint64_to_str>},
    {"sint64", reread<sint64, str_to_sint64, sint64_to_str>},
    {"real32", reread<real32, str_to_real32>},
    {"real64", reread<real64, str_to_real64>},
    {"boolean", reread<boolean, str_to_boolean>},
};

TEST(Number, is_read_as_the_table_says)
{
    for (const auto& row : rows_of("numbers.txt"))
        EXPECT_EQ(readers.at(row.at(0))(row.at(1).c_str()), row.at(2)) << row[0] << " " << row[1];
    for (const auto& [type, read] : readers)
    {
        EXPECT_EQ(read(nullptr), "refused") << type;
        EXPECT_EQ(read("\xB2"), "refused") << type;
    }
    real64 third = 0;
    EXPECT_EQ(str_to_real64(("0." + std::string(1000000, '3')).c_str(), third), 0);
    EXPECT_EQ(third, 1 / 3.0);
}

TEST(Number, writes_what_it_reads)
{
    for (uint64 bit = 1; bit != 0; bit <<= 1)
    {
        for (uint64 x : {bit - 1, bit, bit + 1, bit * 10 - 1, bit * 10})
        {
            EXPECT_EQ(written(uint64_to_str, x), std::to_string(x));
            EXPECT_EQ(written(sint64_to_str, static_cast<sint64>(x)), std::to_string(static_cast<sint64>(x)));
        }
    }
}

TEST(Type, is_found_by_name)
{
    Type type = DATETIME;
    for (const char* name : {"", "uint", "uint128", "string ", "instance"})
        EXPECT_EQ(type_name_to_type(name, type), -1) << name;
    EXPECT_EQ(type, DATETIME);
    EXPECT_EQ(type_name_to_type("Uint8", type), 0);
    EXPECT_EQ(type, UINT8);
}

TEST(Text, is_cut_into_tokens)
{
    const char* rest = " ,key = value";
    const char* start = nullptr;
    std::string tokens;
    while (find_token(rest, " ,=", start, rest) == 0)
        tokens += "[" + std::string(start, rest) + "]";
    EXPECT_EQ(tokens, "[key][value]");
    EXPECT_STREQ(rest, "");
    EXPECT_EQ(find_token(",,", ",", start, rest), -1);
}

} // namespace
