#include "runtime/datetime.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <array>
#include <cstdlib>
#include <cstring>
#include <ctime>
#include <map>
#include <string>
#include <vector>

using namespace zmlr;

namespace
{

class Datetime_Test : public ::testing::Test
{
protected:
    void TearDown() override { in_zone("UTC"); }

    void in_zone(const char* zone)
    {
        setenv("TZ", zone, 1);
        tzset();
    }
};

TEST_F(Datetime_Test, reads_and_writes_both_forms)
{
    constexpr uint64 day = Datetime::DAY;
    const struct
    {
        const char* text;
        bool timestamp;
        uint64 usec;
        sint32 offset;
        const char* pretty;
    } rows[] = {
        {"00000000000000.000000:000", false, 0, 0, "00000000 00 00 00.000000:000"},
        {"00000001023000.000000:000", false, day + 150 * Datetime::MIN, 0, "00000001 02 30 00.000000:000"},
        {"99999999235959.999999:000", false, 100000000 * day - 1, 0, "99999999 23 59 59.999999:000"},
        {"19700101000000.000000+000", true, 0, 0, "1970/01/01 00:00:00.000000+000"},
        {"20110504101201.000042-120", true, 1304503921000042, -120, "2011/05/04 10:12:01.000042-120"},
        {"20380119031408.000000+060", true, 2147483648000000, 60, "2038/01/19 03:14:08.000000+060"},
        {"19691231235959.999999+000", true, static_cast<uint64>(-1), 0, "1969/12/31 23:59:59.999999+000"},
        {"00010101000000.000001+999", true, static_cast<uint64>(-62135596799999999), 999, "0001/01/01 00:00:00.000001+999"},
    };
    in_zone("UTC");
    for (const auto& row : rows)
    {
        Datetime read;
        ASSERT_TRUE(read.set(row.text)) << row.text;
        EXPECT_EQ(read.is_timestamp(), row.timestamp) << row.text;
        EXPECT_EQ(read.usec(), row.usec) << row.text;
        EXPECT_EQ(read.offset(), row.offset) << row.text;
        EXPECT_STREQ(read.ascii(true).c_str(), row.pretty);
        EXPECT_TRUE(read == (row.timestamp ? Datetime(row.usec, row.offset) : Datetime(row.usec)));
        EXPECT_STREQ(read.ascii().c_str(), row.text);
    }
}

TEST_F(Datetime_Test, refuses_other_texts_and_keeps_its_value)
{
    // clang-format off
    const char* const texts[] = {
        nullptr, "", "00000000000000.000000:00", "00000000000000.000000:0000", "00000000000000.000000:001",
        "00000000000000.000000 000", "00000000000000,000000:000", "0000000x000000.000000:000", "-0000001000000.000000:000",
        "2011050410120x.000000+000", "20110504101201.000000+0x0", "20110504101201.00000 +000", "20110504101201:000000+000",
    };
    // clang-format on
    for (const char* text : texts)
    {
        Datetime value(77, 5);
        EXPECT_FALSE(value.set(text)) << (text ? text : "(null)");
        EXPECT_TRUE(value == Datetime(77, 5));
        EXPECT_TRUE(Datetime(text) == Datetime(0, 0));
    }
}

// In the hours that the clock repeats when it is set back the platform chooses one of the two.
TEST_F(Datetime_Test, every_half_hour_of_a_year_comes_back_in_any_zone)
{
    constexpr uint64 new_year = 1704067200 * Datetime::SEC + 999999; // of 2024
    for (const char* zone : {"CET-1CEST,M3.5.0,M10.5.0/3", "EST5EDT,M3.2.0,M11.1.0", "LHST-10:30LHDT-11,M10.1.0,M4.1.0"})
    {
        in_zone(zone);
        std::map<std::string, std::vector<Datetime>> written;
        for (uint64 i = 0; i < 366 * 48; ++i)
        {
            const Datetime time(new_year + i * 30 * Datetime::MIN, -345);
            written[time.ascii().c_str()].push_back(time);
        }
        EXPECT_GE(written.size(), 366U * 48 - 2) << zone;
        for (const auto& [text, times] : written)
            EXPECT_THAT(times, ::testing::Contains(Datetime(text.c_str()))) << zone << " " << text;
    }
}

TEST_F(Datetime_Test, timestamps_are_local_times_beside_their_offset_and_fields_carry_over)
{
    EXPECT_EQ(Datetime("00000000250000.000000:000").usec(), 25 * Datetime::HOUR);
    in_zone("CET-1");
    EXPECT_STREQ(Datetime(0, -90).ascii().c_str(), "19700101010000.000000-090");
    EXPECT_TRUE(Datetime("20110132000000.000000+000") == Datetime("20110201000000.000000+000"));
    in_zone("NPT-5:45");
    EXPECT_STREQ(Datetime(0, 60).ascii().c_str(), "19700101054500.000000+060");
}

TEST_F(Datetime_Test, converts_from_and_to_numbers)
{
    uint32 year, month, day, hour, minute, second, microseconds;
    sint32 offset;
    Datetime time;
    time.set_timestamp(2024, 2, 29, 23, 59, 58, 7, -60);
    time.get_timestamp(year, month, day, hour, minute, second, microseconds, offset);
    EXPECT_EQ((std::array{year, month, day, hour, minute, second, microseconds}),
              (std::array{2024U, 2U, 29U, 23U, 59U, 58U, 7U}));
    EXPECT_EQ(offset, -60);

    time.set_interval(3, 4, 5, 6, 7);
    time.get_interval(day, hour, minute, second, microseconds);
    EXPECT_EQ((std::array{day, hour, minute, second, microseconds}), (std::array{3U, 4U, 5U, 6U, 7U}));
}

TEST_F(Datetime_Test, what_does_not_fit_is_cut_and_terminated)
{
    for (const Datetime& huge : {Datetime(UINT64_MAX), Datetime(INT64_MAX, INT32_MIN), Datetime(uint64{1} << 63, INT32_MAX)})
    {
        char plain[Datetime::text_size], pretty[Datetime::pretty_text_size];
        huge.ascii(plain);
        EXPECT_EQ(std::strlen(plain), 25U);
        huge.ascii(pretty, true);
        EXPECT_LT(std::strlen(pretty), sizeof pretty);
    }
}

TEST_F(Datetime_Test, copies_share_until_one_changes)
{
    const Datetime source(100, 60);
    Datetime copy = source;
    copy.usec(200);
    copy.offset(0);
    EXPECT_TRUE(source == Datetime(100, 60));
    EXPECT_TRUE(copy == Datetime(200, 0));
    copy.clear();
    EXPECT_TRUE(copy == Datetime());
    copy.usec(5);
    EXPECT_TRUE(copy == Datetime(5));

    EXPECT_TRUE(Datetime::now().is_timestamp());
    EXPECT_NEAR(static_cast<double>(Datetime::now().usec()) / Datetime::SEC, static_cast<double>(std::time(nullptr)), 2);
}

} // namespace
