// The event thread: what it fetches, and that it can be stopped at any moment.
#include "tests/hxal/aen_listeners.h"

#include <fcntl.h>
#include <sys/resource.h>
#include <sys/select.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <atomic>
#include <cerrno>
#include <chrono>
#include <cstdlib>
#include <filesystem>
#include <thread>

namespace
{

using testing::ElementsAre;

std::size_t threads()
{
    const std::filesystem::directory_iterator tasks("/proc/self/task");
    return static_cast<std::size_t>(std::distance(begin(tasks), end(tasks)));
}

// A thread that was joined may be listed a moment longer, also among those that are allowed.
bool settles_at(std::size_t allowed)
{
    const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(30);
    while (threads() > allowed && std::chrono::steady_clock::now() < end)
        std::this_thread::yield();
    return threads() <= allowed;
}

class Aen_Thread : public Aen
{
protected:
    // With a process's first thread the thread sanitizer starts another, which stays.
    Aen_Thread()
    {
        std::thread([] {}).join();
    }
    ~Aen_Thread() override { hxal_aen_exit(); }

    // The event number is the `type`; the data is of no interest.
    static void raise(int instance, uint32_t type)
    {
        hxasim::raise_event({.instance = instance, .category = HXA_AEN_CAT_IOC, .type = type});
    }

    // The instances that events are fetched from, in order, until the last IOC of the driver was asked.
    static std::vector<int> fetches()
    {
        std::vector<int> instances;
        while (instances.empty() || instances.back() != 1)
            for (const auto& request : hxasim::take_requests())
                if (request.name == "IOCMD_AEN_GET")
                    instances.push_back(request.instance);
        return instances;
    }
};

TEST_F(Aen_Thread, fetches_again_when_a_batch_was_full_and_tells_the_instances_apart)
{
    Listener first(heard, "first");
    Listener second(heard, "second");
    first.listen(HXA_AEN_CAT_IOC, fc);
    second.listen(HXA_AEN_CAT_IOC, fc1);
    const std::pair<uint32_t, std::size_t> cases[] = {{1, 1}, {63, 1}, {64, 2}, {65, 2}, {127, 2}, {128, 3}};
    for (const auto& [events, expected] : cases)
    {
        std::vector<std::string> told;
        for (uint32_t event = 0; event < events; ++event)
        {
            raise(0, event);
            told.push_back("first " + std::to_string(event));
        }
        raise(1, 7);
        told.emplace_back("second 7"); // on the same descriptor
        hxasim::raise_event({.node = "/dev/hxn", .instance = 0, .category = HXA_AEN_CAT_IOC, .type = 9}); // nobody listens there
        EXPECT_EQ(hxal_aen_init(), HXA_STATUS_OK);
        auto instances = std::vector<int>(expected, 0);
        instances.push_back(1);
        EXPECT_EQ(fetches(), instances) << events;
        EXPECT_EQ(heard.take(told.size()), told);
        hxal_aen_exit();
    }
}

TEST_F(Aen_Thread, stops_and_starts_a_hundred_times_without_losing_an_event)
{
    Listener listener(heard, "it");
    listener.listen(HXA_AEN_CAT_IOC, fc);
    const auto before = threads();
    for (uint32_t round = 0; round < 100; ++round)
    {
        raise(0, round);
        EXPECT_EQ(hxal_aen_init(), HXA_STATUS_OK);
        EXPECT_EQ(hxal_aen_init(), HXA_STATUS_OK) << "it runs already";
        EXPECT_THAT(heard.take(1), ElementsAre("it " + std::to_string(round)));
        hxal_aen_exit();
        EXPECT_TRUE(settles_at(before));
        hxal_aen_exit(); // nothing to stop, and nothing stays behind that stops the next one
    }
}

TEST_F(Aen_Thread, sees_the_stop_between_full_batches)
{
    Listener listener(heard, "it");
    listener.listen(HXA_AEN_CAT_IOC, fc);
    hxasim::inject({.command = "IOCMD_AEN_GET", .answer = {{4, {64, 0, 0, 0}}}}); // never ends
    raise(0, 1);
    hxal_aen_init();
    while (hxasim::request_count() < 100)
        std::this_thread::yield();
    hxal_aen_exit();
    EXPECT_THAT(heard.take(), ElementsAre("it 1"));
}

TEST_F(Aen_Thread, starts_none_for_an_application_without_events)
{
    hxal_libinit(hxa_aen_app_tessik);
    Listener listener(heard, "it");
    listener.listen(HXA_AEN_CAT_IOC, fc);
    const auto before = threads();
    EXPECT_EQ(hxal_aen_init(), HXA_STATUS_OK);
    EXPECT_TRUE(settles_at(before));
}

TEST_F(Aen_Thread, can_be_stopped_and_kept_by_a_callback)
{
    Listener listener(heard, "it");
    listener.listen(HXA_AEN_CAT_IOC, fc);
    listener.then = []
    {
        hxal_aen_exit();
        EXPECT_EQ(hxal_aen_init(), HXA_STATUS_OK);
    };
    hxal_aen_init();
    for (const uint32_t event : {1u, 2u})
    {
        raise(0, event);
        EXPECT_THAT(heard.take(1), ElementsAre("it " + std::to_string(event)));
    }
}

TEST_F(Aen_Thread, loses_no_event_when_callbacks_and_others_stop_and_start_it_at_once)
{
    Listener listener(heard, "it");
    listener.listen(HXA_AEN_CAT_IOC, fc);
    listener.then = []
    {
        hxal_aen_exit();
        hxal_aen_init(); // fails while the other side waits for this thread's end
    };
    const auto before = threads();
    std::vector<std::string> expected;
    for (uint32_t round = 0; round < 500; ++round)
    {
        expected.push_back("it " + std::to_string(round));
        raise(0, round);
        EXPECT_EQ(hxal_aen_init(), HXA_STATUS_OK);
    }
    EXPECT_EQ(heard.take(expected.size()), expected);
    hxal_aen_exit();
    EXPECT_TRUE(settles_at(before));
}

TEST_F(Aen_Thread, does_not_hold_up_the_end_of_the_process)
{
    for (const bool in_callback : {false, true})
    {
        std::fflush(nullptr);
        const pid_t child = fork();
        if (child == 0)
        {
            alarm(60);
            scan_anew();
            Listener listener(heard, "it");
            listener.listen(HXA_AEN_CAT_IOC, fc);
            hxasim::inject({.command = "IOCMD_AEN_GET", .answer = {{4, {64, 0, 0, 0}}}}); // never ends
            raise(0, 1);
            if (in_callback)
                listener.then = [] { std::exit(0); };
            hxal_aen_init();
            while (in_callback || hxasim::request_count() < 100)
                std::this_thread::yield();
            std::exit(0);
        }
        int status = -1;
        EXPECT_EQ(waitpid(child, &status, 0), child);
        EXPECT_EQ(status, 0) << in_callback;
    }
}

TEST_F(Aen_Thread, allows_registrations_to_change_while_it_dispatches)
{
    Listener steady(heard, "steady");
    Listener born(heard, "born");
    steady.listen(HXA_AEN_CAT_IOC, fc);
    steady.then = [&]
    {
        born.end();
        born.listen(HXA_AEN_CAT_IOC, fc);
    };
    // A callback may still run when its registration has ended: what it uses has to last.
    static Heard unheard;
    static Listener guest(unheard, "guest");
    std::atomic<bool> stop = false;
    std::thread other(
        [&]
        {
            while (!stop)
            {
                guest.listen(HXA_AEN_CAT_IOC, fc);
                guest.end();
            }
        });
    hxal_aen_init();
    for (uint32_t round = 0; round < 300; ++round)
    {
        const auto number = " " + std::to_string(round);
        raise(0, round);
        if (round == 0)
            EXPECT_THAT(heard.take(2), ElementsAre("steady" + number, "born" + number));
        else
            EXPECT_THAT(heard.take(3), ElementsAre("born" + number, "steady" + number, "born" + number));
    }
    stop = true;
    other.join();
}

TEST_F(Aen_Thread, goes_on_after_a_failed_fetch)
{
    Listener listener(heard, "it");
    listener.listen(HXA_AEN_CAT_IOC, fc);
    hxasim::inject({.command = "IOCMD_AEN_GET", .instance = 0, .error = EIO, .times = 1});
    raise(0, 1);
    testing::internal::CaptureStdout();
    hxal_aen_init();
    EXPECT_THAT(heard.take(1), ElementsAre("it 1"));
    hxal_aen_exit();
    std::fflush(stdout);
    EXPECT_THAT(testing::internal::GetCapturedStdout(),
                testing::MatchesRegex("hxal_aen_get_events:[0-9]+ ioctl error: Input/output error, fd: " +
                                      std::to_string(fc->fd) + ", app: 2 inst: 0\n"));
}

TEST_F(Aen_Thread, survives_a_count_that_lies)
{
    for (const std::vector<uint8_t>& count : {std::vector<uint8_t>{0xE8, 3, 0, 0}, {0xFF, 0xFF, 0xFF, 0xFF}, {0, 0, 0, 0x80}})
    {
        Listener listener(heard, "it");
        listener.listen(HXA_AEN_CAT_IOC, fc);
        hxasim::inject({.command = "IOCMD_AEN_GET", .instance = 0, .times = 1, .answer = {{4, count}}});
        hxasim::take_requests();
        raise(0, 1);
        hxal_aen_init();
        fetches();
        raise(0, 2);
        if (count[0] == 0xE8)
            EXPECT_THAT(heard.take(2), ElementsAre("it 1", "it 2"));
        else
            EXPECT_THAT(heard.take(1), ElementsAre("it 2")) << "a batch of less than none is none";
        hxal_aen_exit();
    }
}

TEST_F(Aen, hands_on_the_room_and_the_drivers_count)
{
    hxasim::raise_event({.category = HXA_AEN_CAT_IOC, .type = 1});
    hxasim::raise_event({.category = HXA_AEN_CAT_IOC, .type = 2});
    std::vector<hxa_aen_entry_t> room(64);
    const auto get = [&](int count, hxa_aen_app_t app)
    {
        const auto status = hxal_aen_get_events(fc, room.data(), &count, app);
        return std::pair(status, count);
    };
    EXPECT_EQ(get(1, hxa_aen_app_cim), std::pair(HXA_STATUS_OK, 1));
    EXPECT_EQ(room[0].aen_type, 1U);
    EXPECT_EQ(get(1000, hxa_aen_app_cim), std::pair(HXA_STATUS_OK, 1));
    EXPECT_EQ(room[0].aen_type, 2U);
    EXPECT_EQ(get(64, hxa_aen_app_cim), std::pair(HXA_STATUS_OK, 0));
    hxasim::inject({.command = "IOCMD_AEN_GET", .status = 5, .times = 1});
    EXPECT_EQ(get(3, hxa_aen_app_cim), std::pair(static_cast<hxa_status_t>(5), 3));
    hxasim::inject({.command = "IOCMD_AEN_GET", .times = 1, .answer = {{4, {0xE8, 3, 0, 0}}}});
    EXPECT_EQ(get(3, hxa_aen_app_cim), std::pair(HXA_STATUS_OK, 1000));
    const auto sent = hxasim::take_requests().front().sent;
    EXPECT_EQ(sent, (std::vector<uint8_t>{0, 0, 0, 0, 1, 0, 0, 0, 2, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0}));
}

// More descriptors than select() can tell of.
TEST_F(Aen_Thread, waits_on_any_descriptor)
{
    rlimit limit{};
    ASSERT_EQ(getrlimit(RLIMIT_NOFILE, &limit), 0);
    const rlimit before = limit;
    limit.rlim_cur = std::max<rlim_t>(limit.rlim_cur, 2 * FD_SETSIZE);
    ASSERT_EQ(setrlimit(RLIMIT_NOFILE, &limit), 0);
    std::vector<int> fillers;
    do
        fillers.push_back(open("/dev/null", O_RDONLY | O_CLOEXEC));
    while (fillers.back() >= 0 && fillers.back() < FD_SETSIZE);
    scan_anew();
    EXPECT_GT(fc->fd, FD_SETSIZE);
    Listener listener(heard, "it");
    listener.listen(HXA_AEN_CAT_IOC, fc);
    hxal_aen_init();
    raise(0, 1);
    EXPECT_THAT(heard.take(1), ElementsAre("it 1"));
    hxal_aen_exit();
    for (const int filler : fillers)
        close(filler);
    setrlimit(RLIMIT_NOFILE, &before);
}

} // namespace
