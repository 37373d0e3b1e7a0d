#include "runtime/instance_print.h"
#include "runtime/print.h"
#include "tests/runtime/printed.h"
#include "tests/runtime/sample_classes.h"
#include "tests/support/temporary_folder.h"

#include <gtest/gtest.h>

#include <limits>
#include <string>

using namespace zmlr;
using namespace sample;

namespace
{

template <class T> void expect_printed(const T& x, const std::string& text)
{
    EXPECT_EQ(printed([&](std::FILE* stream) { print_scalar(stream, type_code<T>::value, &x); }), text);
    const Array<T> twice = {x, x};
    EXPECT_EQ(printed([&](std::FILE* stream) { print_array(stream, type_code<T>::value, &twice); }),
              "{ " + text + ", " + text + " }");
}

TEST(Print, scalars_and_arrays)
{
    expect_printed(true, "true");
    expect_printed(uint8{255}, "255");
    expect_printed(sint8{-128}, "-128");
    expect_printed(uint16{65535}, "65535");
    expect_printed(sint16{-32768}, "-32768");
    expect_printed(std::numeric_limits<uint32>::max(), "4294967295");
    expect_printed(std::numeric_limits<sint32>::min(), "-2147483648");
    expect_printed(std::numeric_limits<uint64>::max(), "18446744073709551615");
    expect_printed(std::numeric_limits<sint64>::min(), "-9223372036854775808");
    expect_printed(0.25F, "0.250000");
    expect_printed(-1.5e6, "-1500000.000000");
    expect_printed(char16(31), "0x001F");
    expect_printed(char16(32), "' '");
    expect_printed(char16(126), "'~'");
    expect_printed(char16(0xFEFF), "0xFEFF");
    expect_printed(Datetime(uint64{5}), "\"00000000000000.000005:000\"");
    const char text[] = "a \"b\" \\ \t\n\x01\xC3\xBC" // a digit behind an escape is no part of it
                        "1";
    expect_printed(String(text), R"("a \"b\" \\ \t\n\001\303\2741")");
}

TEST(Print, an_instance_is_a_block_and_so_is_what_it_refers_to)
{
    const Ref<Sample_Setting> setting(create<Sample_Setting>(false));
    const auto record = reset_of(element("a\"b"), {Ref<Sample_Setting>(setting).steal(), nullptr});
    record->__name_space = "root/zemlar";
    record->Peer->Labels.value.clear();
    record->Delay.null = 1;
    EXPECT_EQ(printed([&](std::FILE* stream) { fprint(stream, record.ptr()); }),
              Temporary_Folder::content(TEST_TABLES "/printed.txt"));
    EXPECT_NE(printed([&](std::FILE* stream) { fprint(stream, linked({}, {}).ptr()); }).find("Sample_Disk Dependent = NULL;\n"),
              std::string::npos);

    testing::internal::CaptureStdout();
    print(setting.ptr());
    EXPECT_EQ(testing::internal::GetCapturedStdout(), "Sample_Setting\n{\n    uint32 Level = 0;\n}\n");
}

} // namespace
