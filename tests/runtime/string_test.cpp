#include "runtime/string.h"

#include <gtest/gtest.h>

#include <string>

using namespace zmlr;

namespace
{

String of_size(std::size_t n) { return String(std::string(n, 'x').c_str()); }

TEST(String, capacities_are_powers_of_two_from_thirty_two)
{
    // The size of a new one; its capacity; the capacity with one character more.
    constexpr uint32 rows[][3] = {{0, 0, 32}, {1, 32, 32}, {31, 32, 32}, {32, 32, 64}, {33, 64, 64}, {64, 64, 128}};
    for (const auto& [size, made, grown] : rows)
    {
        String with_character = of_size(size), with_text = of_size(size);
        EXPECT_EQ(with_text.capacity(), made) << size;
        with_character.append('y');
        with_text.append("y");
        EXPECT_EQ(with_character.capacity(), grown) << size;
        EXPECT_EQ(with_text.capacity(), grown) << size;
        EXPECT_TRUE(with_text == with_character);
        EXPECT_EQ(with_text.size(), size + 1);
    }
}

TEST(String, changing_a_copy_leaves_the_source_alone)
{
    void (*const changes[])(String&) = {
        [](String& s) { s.append('!'); },  [](String& s) { s.append("more"); }, [](String& s) { s.set(0, 'X'); },
        [](String& s) { s.remove(0, 2); }, [](String& s) { s.clear(); },        [](String& s) { s.assign("other"); },
        [](String& s) { s.reserve(100); }, [](String& s) { s = ""; },           [](String& s) { s.append(s); },
    };
    static constexpr char text[] = "a source that needs more than the least room";
    static constinit Fixed_Text<sizeof text - 1> known(text);
    for (const auto& change : changes)
    {
        for (const String& source : {String(text), String(known)})
        {
            String copy = source;
            EXPECT_EQ(copy.c_str(), source.c_str()) << "copies share";
            change(copy);
            EXPECT_STREQ(source.c_str(), text);
            EXPECT_EQ(source.size(), sizeof text - 1);
            EXPECT_NE(copy.c_str(), source.c_str());
        }
    }
}

TEST(String, all_empty_strings_are_one)
{
    String cleared("text");
    const String holder = cleared;
    cleared.clear();
    for (const String& empty : {String(), String(""), String(nullptr), String("abc", 0), cleared, String("abc").substr(3)})
    {
        EXPECT_EQ(empty.c_str(), String().c_str());
        EXPECT_EQ(empty.capacity(), 0U);
    }

    String own("text");
    own.clear();
    EXPECT_EQ(own.capacity(), 32U) << "an unshared one keeps its room";
}

TEST(String, takes_its_own_text_as_argument)
{
    String s("0123456789");
    s.append(s.c_str() + 5, 5);
    EXPECT_STREQ(s.c_str(), "012345678956789");
    for (int i = 0; i < 4; ++i)
        s.append(s);
    EXPECT_EQ(s.size(), 15U * 16);
    EXPECT_TRUE(s.equal(15 * 15, 15, "012345678956789"));
    s.assign(s.c_str() + 230, 5);
    s = s.c_str() + 3;
    s = *&s;
    s = s.substr(1);
    EXPECT_STREQ(s.c_str(), "9");
}

TEST(String, finds_removes_and_compares)
{
    String s("a.b.c", 5);
    EXPECT_EQ(s.find('.'), 1U);
    EXPECT_EQ(s.find(2, '.'), 3U);
    EXPECT_EQ(s.find(5, '.'), String::npos);
    EXPECT_EQ(s.find("b.c"), 2U);
    EXPECT_EQ(s.find(String("x")), String::npos);
    EXPECT_STREQ(s.substr(2, 2).c_str(), "b.");

    s.remove(1, 2);
    EXPECT_STREQ(s.c_str(), "a.c");
    s.remove(1);
    EXPECT_STREQ(s.c_str(), "a");
    s.set(1, 'b');
    EXPECT_STREQ(s.c_str(), "ab");

    const String with_zero("a\0b", 3);
    EXPECT_TRUE(with_zero.equal("a\0b", 3));
    EXPECT_FALSE(with_zero.equal("a"));
    EXPECT_TRUE(String("WWN-\xC4").equali("wwn-\xC4"));
    EXPECT_FALSE(String("\xC4").equali("\xE4")) << "ASCII letters only";
    EXPECT_STREQ((String("a") + "b" + String("c")).c_str(), "abc");

    String shared = s;
    shared.append('c');
    EXPECT_EQ(shared.capacity(), 64U) << "doubled although there was room";
}

TEST(Text, compares_names_without_regard_to_case)
{
    EXPECT_TRUE(eqi("DeviceID", "deviceid"));
    for (const char* other : {"", "d", "DeviceI", "DeviceID2", "Device[D"})
    {
        EXPECT_FALSE(eqi("DeviceID", other)) << other;
        EXPECT_FALSE(eqi(other, "DeviceID")) << other;
    }
}

TEST(Text, bounded_copy_and_append)
{
    const auto appended = [](std::size_t size, std::size_t result)
    {
        char buffer[8] = "ab";
        EXPECT_EQ(strlcat(buffer, "cd", size), result);
        return std::string(buffer);
    };
    EXPECT_EQ(appended(5, 4), "abcd");
    EXPECT_EQ(appended(4, 4), "abc");
    EXPECT_EQ(appended(2, 2), "ab");
    EXPECT_EQ(appended(0, 0), "ab");

    char small[] = {'x', 'y'};
    EXPECT_EQ(strlcpy(small, "long", 0), 4U);
    EXPECT_EQ(std::string(small, 2), "xy");
    EXPECT_EQ(strlcpy(small, "long", 1), 4U);
    EXPECT_EQ(std::string(small, 2), std::string("\0y", 2));
}

} // namespace
