#include "runtime/buffer.h"

#include <gtest/gtest.h>

#include <string>

using namespace zmlr;

namespace
{

TEST(Buffer, grows_around_its_first_capacity)
{
    for (std::size_t n : {1U, 4095U, 4096U, 4097U, 8193U})
    {
        const std::string text(n, 'x');
        Buffer appended, formatted, single;
        appended.append(text.data(), n);
        formatted.format("%s", text.c_str());
        for (char c : text)
            single.append(c);
        for (Buffer* buffer : {&appended, &formatted, &single})
        {
            EXPECT_EQ(buffer->data(), text);
            EXPECT_EQ(buffer->capacity(), n <= 4096 ? 4096U : n <= 8192 ? 8192U : 16384U);
        }
    }
}

TEST(Buffer, inserts_removes_and_writes_numbers)
{
    Buffer buffer;
    EXPECT_STREQ(buffer.data(), "");
    buffer.append_uint64(18446744073709551615U);
    buffer.insert(0, "[", 1);
    buffer.append(']');
    buffer.append_uint16(0);
    EXPECT_STREQ(buffer.data(), "[18446744073709551615]0");
    buffer.remove(3, 18);
    buffer.insert(3, "--", 2);
    EXPECT_STREQ(buffer.data(), "[18--]0");
}

} // namespace
