#include "runtime/array.h"
#include "runtime/print.h"
#include "tests/runtime/printed.h"

#include <gtest/gtest.h>

#include <limits>
#include <string>

using namespace zmlr;

namespace
{

template <class T> std::string scalar(const T& x)
{
    return printed([&](std::FILE* stream) { print_scalar(stream, type_code<T>::value, &x); });
}

template <class T> std::string array(const Array<T>& x)
{
    return printed([&](std::FILE* stream) { print_array(stream, type_code<T>::value, &x); });
}

TEST(Print, scalars)
{
    EXPECT_EQ(scalar(true), "true");
    EXPECT_EQ(scalar(false), "false");
    EXPECT_EQ(scalar(uint8{255}), "255");
    EXPECT_EQ(scalar(sint8{-128}), "-128");
    EXPECT_EQ(scalar(uint16{65535}), "65535");
    EXPECT_EQ(scalar(sint16{-32768}), "-32768");
    EXPECT_EQ(scalar(std::numeric_limits<uint32>::max()), "4294967295");
    EXPECT_EQ(scalar(std::numeric_limits<sint32>::min()), "-2147483648");
    EXPECT_EQ(scalar(std::numeric_limits<uint64>::max()), "18446744073709551615");
    EXPECT_EQ(scalar(std::numeric_limits<sint64>::min()), "-9223372036854775808");
    EXPECT_EQ(scalar(0.25F), "0.250000");
    EXPECT_EQ(scalar(-1.5e6), "-1500000.000000");
    EXPECT_EQ(scalar(char16(31)), "0x001F");
    EXPECT_EQ(scalar(char16(32)), "' '");
    EXPECT_EQ(scalar(char16(126)), "'~'");
    EXPECT_EQ(scalar(char16(0xFEFF)), "0xFEFF");
    EXPECT_EQ(scalar(String("a \"b\" \\ \t\n\x01\xC3\xBC"
                            "1")),
              R"("a \"b\" \\ \t\n\001\303\2741")");
    EXPECT_EQ(scalar(Datetime(uint64{5})), "\"00000000000000.000005:000\"");
}

TEST(Print, arrays)
{
    EXPECT_EQ(array(Array<boolean>()), "{ }");
    EXPECT_EQ(array(Array<uint32>{7}), "{ 7 }");
    EXPECT_EQ(array(Array<String>{"a", ""}), R"({ "a", "" })");
    EXPECT_EQ(array(Array<Datetime>{Datetime()}), "{ \"00000000000000.000000:000\" }");
}

} // namespace
