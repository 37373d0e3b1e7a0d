#include "runtime/number.h"

#include "runtime/string.h"

#include <gtest/gtest.h>

#include <initializer_list>
#include <limits>
#include <string>

using namespace zmlr;

namespace
{

template <class T> struct Accepted
{
    const char* text;
    T value;
};

template <class T>
void expect_reads(int (*read)(const char*, T&), std::initializer_list<Accepted<T>> accepted,
                  std::initializer_list<const char*> refused)
{
    for (const Accepted<T>& row : accepted)
    {
        T x{};
        EXPECT_EQ(read(row.text, x), 0) << row.text;
        EXPECT_EQ(x, row.value) << row.text;
    }
    for (const char* text : refused)
    {
        T x{1};
        EXPECT_EQ(read(text, x), -1) << (text ? text : "(null)");
        EXPECT_EQ(x, T{1}) << (text ? text : "(null)");
    }
}

TEST(Number, reads_unsigned)
{
    constexpr uint64 largest = std::numeric_limits<uint64>::max();
    expect_reads<uint64>(str_to_uint64,
                         // clang-format off
                         {{"0", 0}, {"07", 7}, {"12345", 12345}, {"00000000000000000001", 1}, {"18446744073709551615", largest},
                          {"0x1F", 31}, {"0X0", 0}, {"0xFFFFFFFFFFFFFFFF", largest}},
                         // clang-format on
                         {"18446744073709551616", "99999999999999999999", "000000000000000000001", "0123456789012345678901",
                          "123x", "123x5", "12x", "1 ", " 1", "+1", "-1", "", nullptr, "0x1f", "0x", "00x1", "0x1G",
                          "0x00000000000000001", "\xB2"});
    expect_reads<uint8>(str_to_uint8, {{"255", 255}, {"0xFF", 255}}, {"256", "-1", "x"});
    expect_reads<uint16>(str_to_uint16, {{"65535", 65535}}, {"65536"});
    expect_reads<uint32>(str_to_uint32, {{"4294967295", 4294967295}}, {"4294967296"});
}

TEST(Number, reads_signed)
{
    constexpr sint64 smallest = std::numeric_limits<sint64>::min();
    constexpr sint64 largest = std::numeric_limits<sint64>::max();
    expect_reads<sint64>(str_to_sint64,
                         // clang-format off
                         {{"-9223372036854775808", smallest}, {"-0x8000000000000000", smallest}, {"9223372036854775807", largest},
                          {"+9223372036854775807", largest}, {"+0x7FFFFFFFFFFFFFFF", largest}, {"-0x10", -16}, {"-0", 0}},
                         // clang-format on
                         {"-9223372036854775809", "-0x8000000000000001", "9223372036854775808", "+0x8000000000000000", "-", "+",
                          "--1", "+-1", "- 1", "", nullptr});
    expect_reads<sint8>(str_to_sint8, {{"127", 127}, {"-128", -128}}, {"128", "-129", "x"});
    expect_reads<sint16>(str_to_sint16, {{"32767", 32767}, {"-32768", -32768}}, {"32768", "-32769"});
    expect_reads<sint32>(str_to_sint32, {{"2147483647", 2147483647}, {"-2147483648", -2147483647 - 1}},
                         {"2147483648", "-2147483649"});
}

TEST(Number, reads_reals_and_booleans)
{
    constexpr real64 infinity = std::numeric_limits<real64>::infinity();
    const std::string long_fraction = "0." + std::string(1000000, '3');
    expect_reads<real64>(
        str_to_real64,
        // clang-format off
        {{"1.0", 1}, {".5", 0.5}, {"-.5", -0.5}, {"+1.5e3", 1500}, {"1.5E-3", 0.0015}, {"0.1", 0.1}, {"1.0e+400", infinity},
         {"-1.0e400", -infinity}, {"1.0e-400", 0}, {long_fraction.c_str(), 1 / 3.0}},
        // clang-format on
        {"1", "1.", ".", "-", "1.5e", "1.5e+", "1.5e3x", "1.5x", " 1.5", "1,5", "0x1.8p3", "inf", "nan", "", nullptr});
    expect_reads<real32>(str_to_real32, {{"0.1", 0.1F}, {"1.0e39", std::numeric_limits<real32>::infinity()}}, {"1"});
    expect_reads<boolean>(str_to_boolean, {{"true", true}, {"FALSE", false}}, {"", "t", "true ", "truely", "1", nullptr});
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
    Type type = UINT8;
    for (uint32 i = 0; i < num_types; ++i)
    {
        EXPECT_EQ(type_name_to_type(type_name[i], type), 0);
        EXPECT_EQ(type, static_cast<Type>(i));
    }
    for (const char* name : {"", "uint", "uint128", "string ", "instance"})
        EXPECT_EQ(type_name_to_type(name, type), -1) << name;
    EXPECT_EQ(type, DATETIME);
    EXPECT_EQ(type_name_to_type("Uint8", type), 0);
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
