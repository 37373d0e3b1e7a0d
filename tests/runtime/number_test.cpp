#include "runtime/number.h"

#include "runtime/string.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <optional>
#include <string>

using namespace zmlr;

namespace
{

template <class T> struct Case
{
    const char* text;
    std::optional<T> value; // none: refused
};

template <class T, std::size_t N> void expect_reads(int (*read)(const char*, T&), const Case<T> (&cases)[N])
{
    for (const Case<T>& c : cases)
    {
        T x{7};
        EXPECT_EQ(read(c.text, x), c.value ? 0 : -1) << (c.text ? c.text : "(null)");
        EXPECT_EQ(x, c.value.value_or(T{7})) << (c.text ? c.text : "(null)");
    }
}

TEST(Number, reads_unsigned)
{
    constexpr std::nullopt_t no = std::nullopt;
    constexpr uint64 largest = std::numeric_limits<uint64>::max();
    const Case<uint64> cases[] = {
        {"0", 0},
        {"07", 7}, // leading zeros do not count
        {"007", 7},
        {"9999", 9999},
        {"12345", 12345},
        {"18446744073709551615", largest},
        {"00000000000000000001", 1},
        {"18446744073709551616", no},
        {"99999999999999999999", no},
        {"000000000000000000001", no}, // a 21st digit
        {"0123456789012345678901", no},
        {"123x", no},
        {"123x5", no},
        {"12x", no},
        {"1 ", no},
        {" 1", no},
        {"+1", no},
        {"-1", no},
        {"", no},
        {nullptr, no},
        {"0x1F", 31},
        {"0X0", 0},
        {"0xFFFFFFFFFFFFFFFF", largest},
        {"0x1f", no},
        {"0x", no},
        {"00x1", no},
        {"0x1G", no},
        {"0x00000000000000001", no}, // a 17th digit
        {"\xB2", no},
    };
    expect_reads(str_to_uint64, cases);
    expect_reads<uint8>(str_to_uint8, {{"255", 255}, {"256", no}, {"0xFF", 255}, {"-1", no}, {"x", no}});
    expect_reads<uint16>(str_to_uint16, {{"65535", 65535}, {"65536", no}});
    expect_reads<uint32>(str_to_uint32, {{"4294967295", 4294967295}, {"4294967296", no}});
}

TEST(Number, reads_signed)
{
    constexpr std::nullopt_t no = std::nullopt;
    constexpr sint64 smallest = std::numeric_limits<sint64>::min();
    constexpr sint64 largest = std::numeric_limits<sint64>::max();
    const Case<sint64> cases[] = {
        {"-9223372036854775808", smallest},
        {"-0x8000000000000000", smallest},
        {"-9223372036854775809", no},
        {"9223372036854775807", largest},
        {"+9223372036854775807", largest},
        {"+0x7FFFFFFFFFFFFFFF", largest},
        {"9223372036854775808", no},
        {"+9223372036854775808", no},
        {"-0x10", -16},
        {"-0", 0},
        {"-", no},
        {"+", no},
        {"--1", no},
        {"+-1", no},
        {"", no},
        {nullptr, no},
    };
    expect_reads(str_to_sint64, cases);
    expect_reads<sint8>(str_to_sint8, {{"127", 127}, {"128", no}, {"-128", -128}, {"-129", no}, {"x", no}});
    expect_reads<sint16>(str_to_sint16, {{"32767", 32767}, {"32768", no}, {"-32768", -32768}, {"-32769", no}});
    expect_reads<sint32>(str_to_sint32,
                         {{"2147483647", 2147483647}, {"2147483648", no}, {"-2147483648", -2147483647 - 1}, {"-2147483649", no}});
}

TEST(Number, reads_reals)
{
    constexpr std::nullopt_t no = std::nullopt;
    constexpr real64 infinity = std::numeric_limits<real64>::infinity();
    const std::string long_fraction = "0." + std::string(1000000, '3');
    const Case<real64> cases[] = {
        {"1.0", 1},
        {".5", 0.5},
        {"-.5", -0.5},
        {"+1.5e3", 1500},
        {"1.5E-3", 0.0015},
        {"0.1", 0.1},
        {"1.0e+400", infinity},
        {"-1.0e400", -infinity},
        {"1.0e-400", 0},
        {long_fraction.c_str(), 1 / 3.0},
        {"1", no},
        {"1.", no},
        {".", no},
        {"-", no},
        {"1.5e", no},
        {"1.5e+", no},
        {"1.5e3x", no},
        {"1.5x", no},
        {" 1.5", no},
        {"1,5", no},
        {"0x1.8p3", no},
        {"inf", no},
        {"nan", no},
        {"", no},
        {nullptr, no},
    };
    expect_reads(str_to_real64, cases);
    expect_reads<real32>(str_to_real32, {{"0.1", 0.1F}, {"1.0e39", std::numeric_limits<real32>::infinity()}, {"1", no}});
}

TEST(Number, reads_booleans)
{
    for (const char* text : {"true", "TRUE", "True", "false", "FALSE"})
    {
        const bool expected = eqi(text, "true");
        boolean x = !expected;
        EXPECT_EQ(str_to_boolean(text, x), 0) << text;
        EXPECT_EQ(x, expected);
    }
    for (const char* text : {"", "t", "true ", "truely", "1", static_cast<const char*>(nullptr)})
    {
        boolean x = true;
        EXPECT_EQ(str_to_boolean(text, x), -1);
        EXPECT_TRUE(x);
    }
}

template <class T> std::string written(const char* (*write)(char (&)[number_text_size], T, uint32&), T x)
{
    char buffer[number_text_size];
    uint32 size = 0;
    const char* text = write(buffer, x, size);
    EXPECT_EQ(text[size], '\0');
    return std::string(text, size);
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
    EXPECT_EQ(written(uint8_to_str, uint8{255}), "255");
    EXPECT_EQ(written(sint8_to_str, sint8{-128}), "-128");
    EXPECT_EQ(written(uint16_to_str, uint16{65535}), "65535");
    EXPECT_EQ(written(sint16_to_str, sint16{-32768}), "-32768");
    EXPECT_EQ(written(uint32_to_str, 4294967295U), "4294967295");
    EXPECT_EQ(written(sint32_to_str, -2147483647 - 1), "-2147483648");
}

TEST(Type, is_found_by_name)
{
    for (uint32 i = 0; i < num_types; ++i)
    {
        Type type = DATETIME;
        EXPECT_EQ(type_name_to_type(type_name[i], type), 0);
        EXPECT_EQ(type, static_cast<Type>(i));
    }
    Type type = UINT8;
    EXPECT_EQ(type_name_to_type("DateTime", type), 0);
    EXPECT_EQ(type, DATETIME);
    for (const char* name : {"", "uint", "uint128", "string ", "instance"})
        EXPECT_EQ(type_name_to_type(name, type), -1) << name;
    EXPECT_EQ(type, DATETIME);
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
