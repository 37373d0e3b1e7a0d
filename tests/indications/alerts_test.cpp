// The alerts of the module, as its server takes them: what waits, what is lost and told, and what enabling leaves behind.
#include "cimserver/indications/indication_providers.h"
#include "cimserver/model/values.h"
#include "hxal/records/aen.h"
#include "tests/module/loaded_module.h"
#include "tests/runtime/home.h"
#include "tests/runtime/resources.h"

#include <gmock/gmock.h>

#include <arpa/inet.h>
#include <netdb.h>
#include <poll.h>
#include <sys/resource.h>
#include <unistd.h>

#include <atomic>
#include <condition_variable>
#include <cstring>
#include <mutex>
#include <optional>

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

namespace
{

// The host's name service: how long it takes, and how often it was asked.
std::atomic<int> lookup_milliseconds = 0;
std::atomic<int> lookups = 0;

} // namespace

extern "C" [[gnu::visibility("default")]] int gethostbyname_r(const char*, hostent* entry, char*, size_t, hostent** result, int*)
{
    static in_addr address = {inet_addr("192.0.2.10")};
    static char* list[] = {reinterpret_cast<char*>(&address), nullptr};
    ++lookups;
    poll(nullptr, 0, lookup_milliseconds); // the simulator does not shorten it
    *entry = {.h_name = nullptr, .h_aliases = nullptr, .h_addrtype = AF_INET, .h_length = sizeof(in_addr), .h_addr_list = list};
    *result = entry;
    return 0;
}

namespace
{

// A limit of the process, for a scope.
struct Limit
{
    Limit(__rlimit_resource what, rlim_t most) : resource(what)
    {
        getrlimit(what, &before);
        const rlimit limit = {most, before.rlim_max};
        setrlimit(what, &limit);
    }
    ~Limit() { setrlimit(resource, &before); }

    __rlimit_resource resource;
    rlimit before{};
};

void set_stack_size(std::size_t size)
{
    pthread_attr_t attributes;
    pthread_getattr_default_np(&attributes);
    pthread_attr_setstacksize(&attributes, size);
    pthread_setattr_default_np(&attributes);
}

std::size_t mapped_bytes()
{
    std::size_t pages = 0;
    std::ifstream("/proc/self/statm") >> pages;
    return pages * static_cast<std::size_t>(sysconf(_SC_PAGESIZE));
}

// What the server was handed, as "name space|number": the events of these tests are fabrics whose names are numbers.
class Sink : public cimserver::Indication_Sink
{
public:
    void deliver(const std::string& where, const cimserver::Instance& indication) override
    {
        for (const auto& [name, value] : indication.properties)
            if (name == "MessageArguments")
            {
                const auto& arguments = value.get<std::vector<cimserver::Value>>();
                const auto number = std::stoul(arguments.back().get<cimserver::Text>(), nullptr, 16);
                std::unique_lock lock(_mutex);
                _taken.push_back(where + '|' + std::to_string(number));
                _changed.notify_all();
                _changed.wait(lock, [this] { return !_held; });
            }
    }

    // Deliveries wait, and the module with them, until it is let go.
    void hold(bool held)
    {
        const std::lock_guard lock(_mutex);
        _held = held;
        _changed.notify_all();
    }

    std::vector<std::string> take(std::size_t count = 0) // what there is, once there is that much
    {
        std::unique_lock lock(_mutex);
        _changed.wait_for(lock, std::chrono::seconds(100), [&] { return _taken.size() >= count; });
        return std::exchange(_taken, {});
    }

private:
    std::mutex _mutex;
    std::condition_variable _changed;
    std::vector<std::string> _taken;
    bool _held = false;
};

class Alerts : public Loaded_Module
{
protected:
    Alerts()
    {
        _home.options("LOG_LEVEL=WARN\n");
        setenv("HOME", _home.path("").c_str(), 1);
        hxasim::set_time_scale(0.001);
        lookup_milliseconds = 0;
    }
    ~Alerts() override { hxasim::set_time_scale(1); }

    void TearDown() override
    {
        providers.reset(); // does not disable
        Loaded_Module::TearDown();
    }

    void load(const std::string& scenario, cimserver::Indication_Order order = cimserver::Indication_Order::open_pegasus)
    {
        providers.reset();
        Loaded_Module::load(scenario);
        module().broker().set_indication_sink(&sink);
        providers.emplace(module(), order);
    }

    void start(const std::string& name = "filter", const std::string& name_space = "root/zemlar")
    {
        providers->start(name, {"SELECT * FROM CIM_AlertIndication", "CIM_AlertIndication", name_space});
    }
    bool starts()
    try
    {
        start();
        return true;
    }
    catch (const cimserver::Cim_Error&)
    {
        return false;
    }
    void stop(const std::string& name = "filter") { providers->stop(name); }

    static void raise(int first, int count = 1, int port = 0)
    {
        const std::vector<std::uint8_t> wwn = {0x10, 0, 0, 5, 0x1E, 0x12, 0x34, static_cast<std::uint8_t>(0x56 + port)};
        for (int number = first; number < first + count; ++number)
        {
            auto data = wwn;
            data.insert(data.end(),
                        {0, 0, 0, 0, 0, 0, static_cast<std::uint8_t>(number >> 8), static_cast<std::uint8_t>(number)});
            hxasim::raise_event(
                {.instance = port, .category = HXA_AEN_CAT_PORT, .type = HXA_PORT_AEN_FABRIC_NAME_CHANGE, .data = data});
        }
    }

    // Until all of so many events at the first port have been made alerts: the next port is asked.
    static void wait_until_heard(int count)
    {
        const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(100);
        for (bool next = false; count > 0 || !next; poll(nullptr, 0, 1))
        {
            ASSERT_LT(std::chrono::steady_clock::now(), deadline) << count << " events are left";
            for (const auto& request : hxasim::take_requests())
            {
                ASSERT_EQ(request.name, "IOCMD_AEN_GET");
                std::int32_t delivered = 0;
                std::memcpy(&delivered, &request.answered.at(4), sizeof delivered);
                count -= request.instance == 0 ? delivered : 0;
                next = request.instance == 1 || (next && delivered == 0);
            }
        }
    }

    sample::Home _home;
    Sink sink;
    std::optional<cimserver::Indication_Providers> providers;
};

} // namespace

TEST_F(Alerts, go_once_to_each_name_space_that_wants_them)
{
    load("fc-hba");
    start("a", "root/x");
    start("b", "root/x");
    start("c", "root/y");
    raise(1);
    EXPECT_THAT(sink.take(2), ElementsAre("root/x|1", "root/y|1"));
    stop("a");
    stop("c");
    raise(2);
    raise(3);
    EXPECT_THAT(sink.take(2), ElementsAre("root/x|2", "root/x|3"));
    stop("b");
    EXPECT_THAT(sink.take(), IsEmpty());
}

// One fetch holds 64 events. What comes while they are disabled is thrown away by the next enabling, but for what is beyond.
TEST_F(Alerts, begin_with_what_happens_from_then_on)
{
    load("fc-hba");
    raise(1, 66);
    requests();
    start();
    EXPECT_THAT(sink.take(2), ElementsAre("root/zemlar|65", "root/zemlar|66"));
    stop();
    EXPECT_THAT(requests(), testing::Each(testing::StartsWith("IOCMD_AEN_GET ")));
}

TEST_F(Alerts, that_wait_at_a_disable_come_after_the_next_enable)
{
    load("fc-hba", cimserver::Indication_Order::sfcb);
    hxasim::set_time_scale(0.1);
    start();
    requests();
    raise(0, 300);
    wait_until_heard(300);
    stop();
    auto delivered = sink.take();
    EXPECT_THAT(delivered, SizeIs(testing::Lt(300U)));
    raise(999);
    start();
    const auto rest = sink.take(300 - delivered.size());
    delivered.insert(delivered.end(), rest.begin(), rest.end());
    std::vector<std::string> expected;
    for (int number = 0; number < 300; ++number)
        expected.push_back("root/zemlar|" + std::to_string(number));
    EXPECT_EQ(delivered, expected);
}

TEST_F(Alerts, wait_in_a_list_that_is_bounded)
{
    load("fc-hba");
    start();
    for (int overflow = 1; overflow <= 2; ++overflow)
    {
        sink.hold(true);
        raise(0);
        EXPECT_THAT(sink.take(1), SizeIs(1));
        requests();
        raise(1, 11'000);
        wait_until_heard(11'000);
        sink.hold(false);
        const auto kept = sink.take(10'000);
        EXPECT_THAT(kept, SizeIs(10'000));
        EXPECT_EQ(kept.front(), "root/zemlar|1001");
        EXPECT_EQ(kept.back(), "root/zemlar|11000");
        const auto log = _home.lines();
        EXPECT_EQ(std::ranges::count_if(log, [](const auto& line) { return line.find(" WARN: IndicationHelper(") != line.npos; }),
                  overflow);
    }
}

TEST_F(Alerts, look_the_host_up_once_and_do_not_queue_for_a_slow_name_server)
{
    load("fc-hba");
    start();
    lookups = 0;
    raise(1);
    sink.take(1);
    EXPECT_EQ(lookups, 1);
    lookups = 0;
    lookup_milliseconds = 300;
    raise(1, 30, 0);
    raise(31, 1, 1);
    EXPECT_THAT(sink.take(31), SizeIs(31));
    EXPECT_LE(lookups, 2);
}

// The events' thread wants a descriptor, the delivery thread memory for a second stack.
TEST_F(Alerts, are_all_refused_or_none)
{
    load("fc-hba");
    const auto refuse_twice = [this]
    {
        set_stack_size(std::size_t{4} << 30);
        {
            const Limit one_stack(RLIMIT_AS, mapped_bytes() + (std::size_t{6} << 30));
            EXPECT_FALSE(starts());
        }
        set_stack_size(std::size_t{8} << 20);
        const Limit no_descriptor(RLIMIT_NOFILE, 0);
        EXPECT_FALSE(starts());
        requests(); // what the simulator remembers is no leak
    };
    sample::repeat(1, refuse_twice);
    const sample::Resources before;
    sample::repeat(1, refuse_twice);
    EXPECT_EQ(sample::Resources(), before);
    EXPECT_THAT(_home.lines(), SizeIs(6));

    start();
    raise(1, 2);
    EXPECT_THAT(sink.take(2), ElementsAre("root/zemlar|1", "root/zemlar|2")) << "registered once";
}

TEST_F(Alerts, leave_nothing_behind_however_often_they_come_and_go)
{
    load("mixed");
    std::atomic<bool> raining = true;
    const auto rain = [&]
    {
        for (std::uint8_t i = 0; raining; ++i)
        {
            raise(i, 10, i % 2);
            i % 8 == 0 ? hxasim::unplug(1) : void();
            i % 8 == 4 ? hxasim::plug(1) : void();
            std::this_thread::sleep_for(std::chrono::microseconds(200));
        }
    };
    const auto round = [&]
    {
        start();
        sink.take(1);
        stop();
        sink.take();
        EXPECT_THAT(sink.take(), IsEmpty()) << "no callback runs after a disable";
        requests();
    };
    const auto storm = [&](int rounds)
    {
        raining = true;
        std::thread weather(rain);
        for (int i = 0; i < rounds; ++i)
            round();
        raining = false;
        weather.join();
        load("mixed"); // what waits goes with the module
        requests();
    };
    sample::repeat(3, [&] { storm(20); });
    const sample::Resources before;
    sample::repeat(1, [&] { storm(200); });
    sample::Resources after;
    EXPECT_NEAR(static_cast<double>(after.heap), static_cast<double>(before.heap), 2000) << "less than anything 200 times";
    after.heap = before.heap;
    EXPECT_EQ(after, before);
}

// Some servers unload a module that is enabled, some end without a word to it.
TEST_F(Alerts, do_not_hold_up_the_end)
{
    GTEST_FLAG_SET(death_test_style, "threadsafe");
    load("fc-hba");
    start();
    raise(1, 100);
    sink.take(1);
    load("fc-hba");
    setenv("ASAN_OPTIONS", "detect_leaks=0", 1); // of the child: nobody can look for leaks while threads end
    EXPECT_EXIT(
        {
            load("fc-hba");
            start();
            raise(1, 200);
            sink.take(1);
            std::filesystem::remove_all(_home.path("")); // nobody else does
            std::exit(0);
        },
        testing::ExitedWithCode(0), "");
}
