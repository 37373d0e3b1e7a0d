#include "runtime/array.h"

#include <gtest/gtest.h>

#include <limits>
#include <string>

using namespace zmlr;

namespace
{

Array<String> strings(uint32 n)
{
    Array<String> result;
    for (uint32 i = 0; i < n; ++i)
        result.append(String(std::to_string(i).c_str()));
    return result;
}

TEST(Array, capacity_is_the_power_of_two_that_holds_the_elements)
{
    constexpr uint32 rows[][2] = {{0, 8}, {8, 8}, {9, 16}, {16, 16}, {17, 32}, {100, 128}};
    for (const auto& [size, capacity] : rows)
    {
        Array<uint32> resized, appended, reserved;
        resized.resize(size, 7);
        reserved.reserve(size);
        for (uint32 i = 0; i < size; ++i)
            appended.append(7);
        for (const auto* array : {&resized, &appended, &reserved})
            EXPECT_EQ(array->capacity(), capacity) << size;
        EXPECT_TRUE(appended == resized);
        EXPECT_TRUE(reserved.empty());
    }
}

TEST(Array, copies_share_nothing)
{
    const Array<String> source = {"a", "b", "c"};
    Array<String> copy = source;
    Array<String> assigned = {"x"};
    assigned = source;
    copy[0] = "changed";
    assigned.remove(0, 3);
    EXPECT_TRUE(source == (Array<String>{"a", "b", "c"}));

    assigned = std::move(copy);
    EXPECT_EQ(assigned.find("changed"), 0U);
    EXPECT_EQ(assigned.find("a"), 0xFFFFFFFF);
}

TEST(Array, inserts_its_own_elements_whether_it_grows_or_not)
{
    for (uint32 n : {1U, 3U, 4U, 7U, 8U, 15U, 16U})
    {
        for (uint32 pos : {0U, n / 2, n})
        {
            Array<String> array = strings(n);
            array.insert(pos, array.data(), n);
            ASSERT_EQ(array.size(), 2 * n);
            for (uint32 i = 0; i < n; ++i)
            {
                EXPECT_EQ(array[pos + i], std::to_string(i).c_str()) << n << " at " << pos;
                EXPECT_EQ(array[i < pos ? i : n + i], std::to_string(i).c_str()) << n << " at " << pos;
            }
        }
    }
}

TEST(Array, edits_in_place)
{
    Array<String> array = strings(4);
    array.prepend("first");
    array.remove(1, 2);
    array.append("last");
    EXPECT_TRUE(array == (Array<String>{"first", "2", "3", "last"}));

    array.resize(2, "");
    array.resize(4, array[0]);
    EXPECT_TRUE(array == (Array<String>{"first", "2", "first", "first"}));
    array.clear();
    EXPECT_TRUE(array == Array<String>());
}

TEST(Array, compares_reals_as_numbers_and_the_rest_as_bytes)
{
    const real64 nan = std::numeric_limits<real64>::quiet_NaN();
    EXPECT_FALSE(Array<real64>{nan} == Array<real64>{nan});
    EXPECT_TRUE(Array<real32>{0.0F} == Array<real32>{-0.0F});
    EXPECT_FALSE((Array<uint8>{1, 2}) == (Array<uint8>{1}));
    EXPECT_TRUE(Array<Datetime>{Datetime(5)} == Array<Datetime>{Datetime(5)});
    EXPECT_FALSE(Array<Datetime>{Datetime(5)} == Array<Datetime>{Datetime(5, 0)});
}

} // namespace
