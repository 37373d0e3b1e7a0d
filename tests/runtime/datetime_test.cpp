#include "runtime/datetime.h"

#include "tests/support/rows.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <array>
#include <cstdlib>
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

TEST_F(Datetime_Test, reads_and_writes_both_forms_and_nothing_else)
{
    in_zone("UTC");
    for (const auto& row : rows_of("datetimes.txt"))
    {
        SCOPED_TRACE(row[0]);
        Datetime read(77, 5);
        const bool good = row.at(1) != "refused";
        ASSERT_EQ(read.set(row[0].c_str()), good);
        if (!good)
        {
            EXPECT_TRUE(read == Datetime(77, 5));
            EXPECT_TRUE(Datetime(row[0].c_str()) == Datetime(0, 0));
            continue;
        }
        EXPECT_EQ(read.is_timestamp(), row[1] == "timestamp");
        EXPECT_EQ(read.usec(), static_cast<uint64>(std::stoll(row.at(2))));
        EXPECT_EQ(read.offset(), std::stoi(row.at(3)));
        EXPECT_EQ(read.ascii(true), row.at(4).c_str());
        EXPECT_EQ(read.ascii(), row[0].c_str());
    }
    EXPECT_FALSE(Datetime().set(nullptr));
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
}

// Never a text of another form, which would make a client refuse the whole answer.
TEST_F(Datetime_Test, what_no_text_can_tell_is_the_nearest_that_one_can)
{
    in_zone("UTC");
    const std::pair<Datetime, const char*> rows[] = {
        {Datetime(100'000'000 * Datetime::DAY), "99999999 23 59 59.999999:000"},
        {Datetime(UINT64_MAX), "99999999 23 59 59.999999:000"},
        {Datetime(253402300800 * Datetime::SEC, 0), "9999/12/31 23:59:59.999999+000"},
        {Datetime(INT64_MAX, INT32_MAX), "9999/12/31 23:59:59.999999+999"},
        {Datetime(uint64{1} << 63, INT32_MIN), "0000/01/01 00:00:00.000000-999"},
    };
    for (const auto& [huge, pretty] : rows)
    {
        EXPECT_EQ(huge.ascii(true), pretty);
        EXPECT_TRUE(Datetime().set(huge.ascii().c_str())) << huge.ascii().c_str();
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
