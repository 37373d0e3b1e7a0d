// Sleeps are shortened and told with the next request; what waits for a descriptor is not.
#include "tests/sim/simulated_host.h"

#include <sys/eventfd.h>
#include <sys/select.h>
#include <sys/time.h>

#include <ctime>

namespace
{

using namespace std::chrono_literals;

using Clock = std::chrono::steady_clock;

class Waits : public Raw_Host
{
protected:
    Waits() : Raw_Host("cna") {}
    ~Waits() override { hxasim::set_time_scale(1); }

    // What the next request tells.
    std::chrono::nanoseconds told()
    {
        instances(hxa, 'C');
        return hxasim::take_requests().back().slept;
    }

    template <typename Wait> static Clock::duration time_of(Wait wait)
    {
        const auto begin = Clock::now();
        wait();
        return Clock::now() - begin;
    }

    Open_File hxa{"/dev/hxa"};
};

TEST_F(Waits, are_shortened_in_every_form_and_told_in_full)
{
    hxasim::set_time_scale(0.001);
    const timespec two_seconds{.tv_sec = 2, .tv_nsec = 500};
    EXPECT_LT(time_of([&] { EXPECT_EQ(nanosleep(&two_seconds, nullptr), 0); }), 1s);
    EXPECT_EQ(told(), 2s + 500ns);

    timeval timeout{.tv_sec = 3, .tv_usec = 7};
    EXPECT_LT(time_of([&] { EXPECT_EQ(usleep(2'000'000), 0); }), 1s);
    EXPECT_LT(time_of([&] { EXPECT_EQ(select(0, nullptr, nullptr, nullptr, &timeout), 0); }), 1s);
    EXPECT_EQ(timeout.tv_sec, 0);
    EXPECT_EQ(told(), 5s + 7us);
    EXPECT_EQ(told(), 0s);
}

TEST_F(Waits, for_a_descriptor_and_without_a_scale_keep_their_time)
{
    hxasim::set_time_scale(0);
    Open_File quiet(eventfd(0, 0));
    fd_set readable;
    FD_ZERO(&readable);
    FD_SET(*quiet, &readable);
    timeval timeout{.tv_sec = 0, .tv_usec = 50'000};
    EXPECT_GE(time_of([&] { EXPECT_EQ(select(*quiet + 1, &readable, nullptr, nullptr, &timeout), 0); }), 50ms);
    hxasim::set_time_scale(1);
    EXPECT_GE(time_of([] { usleep(50'000); }), 50ms);
    EXPECT_EQ(told(), 50ms);
}

} // namespace
