// Many starts at once, and lives that end in the middle of a run.
#include "tests/diagnostics/diagnostics_fixture.h"
#include "tests/runtime/resources.h"

#include <array>
#include <atomic>
#include <barrier>
#include <chrono>
#include <cstdlib>
#include <pthread.h>

namespace
{

class Life : public Diagnostics
{
protected:
    struct Test
    {
        const char* test_class;
        const char* name;
        const char* element_class;
    };
    static constexpr Test tests[] = {
        {"ZEMLAR_PCILoopbackDiagnosticTest", "PCILoopbackTest", "ZEMLAR_FCPort"},
        {"ZEMLAR_LoopbackDiagnosticTest", "SerdesLoopbackTest", "ZEMLAR_FCPort"},
        {"ZEMLAR_EthLoopbackDiagnosticTest", "SerdesEthLoopbackTest", "ZEMLAR_EthernetPort"},
        {"ZEMLAR_MemoryDiagnosticTest", "MemoryTest", "ZEMLAR_PortController"},
    };

    // Starts of all tests by 8 clients, until so many succeeded.
    static void start_runs(int wanted)
    {
        std::atomic<int> started = 0;
        std::vector<std::thread> clients;
        for (std::size_t client = 0; client < 8; ++client)
            clients.emplace_back(
                [&, client]
                {
                    const Test& test = tests[client % std::size(tests)];
                    const auto element = path(test.element_class, 0);
                    while (started < wanted)
                    {
                        const Answer answer = run(test.test_class, test.name, element);
                        EXPECT_TRUE(answer.code == "4096" || answer.code == "4") << answer.code;
                        EXPECT_EQ(answer.job, answer.code == "4" ? "" : std::string("Zemlar:") + test.name);
                        started += answer.code == "4096";
                    }
                });
        for (auto& client : clients)
            client.join();
    }

    static void read_all()
    {
        enumerate("ZEMLAR_ConcreteJob");
        enumerate("ZEMLAR_AffectedJobElement");
        for (const char* name : {"ZEMLAR_DiagnosticServiceRecord", "ZEMLAR_DiagnosticCompletionRecord"})
        {
            const auto records = enumerate(name);
            EXPECT_LE(records.size(), 100U);
            int before = 0;
            for (const auto& record : records)
            {
                const std::string id = value(record, "InstanceID");
                const int number = std::stoi(id.substr(id.rfind(':') + 1));
                EXPECT_GT(number, before) << name;
                before = number;
            }
        }
        EXPECT_LE(enumerate("ZEMLAR_ServiceRecordAppliesToElement").size(), 100U);
        EXPECT_LE(enumerate("ZEMLAR_CompletionRecordAppliesToElement").size(), 100U);
    }
};

} // namespace

const bool wants_log = false;

// Each client has a test of its own: starts of one class wait for each other before they come to the job.
TEST_F(Life, of_starts_that_meet_one_runs)
{
    constexpr int a_run_takes = 300; // ms at least
    for (const char* command : {"LOOPBACK", "LL_LOOPBACK", "FWPING", "MEMTEST"})
        hxasim::inject({.command = std::string("IOCMD_DIAG_") + command, .delay = a_run_takes});
    for (int judged = 0; judged < 20;)
    {
        std::barrier meeting(std::size(tests));
        std::array<std::string, std::size(tests)> codes;
        std::vector<std::thread> clients;
        const auto start = std::chrono::steady_clock::now();
        for (std::size_t client = 0; client < codes.size(); ++client)
            clients.emplace_back(
                [&, client]
                {
                    const Test& test = tests[client];
                    const auto element = path(test.element_class, 0);
                    meeting.arrive_and_wait();
                    codes[client] = run(test.test_class, test.name, element).code;
                });
        for (auto& client : clients)
            client.join();
        // A client that was held up beyond the first run may start the next one.
        if (std::chrono::steady_clock::now() - start < std::chrono::milliseconds(a_run_takes))
        {
            EXPECT_THAT(codes, testing::UnorderedElementsAre("4096", "4", "4", "4"));
            ++judged;
        }
        wait_for_end();
    }
}

TEST_F(Life, starts_of_many_clients_while_others_read)
{
    const char* const wanted = std::getenv("DIAGNOSTIC_RUNS");
    const std::string before = states();
    std::atomic<bool> over = false;
    std::vector<std::thread> readers;
    for (int reader = 0; reader < 8; ++reader)
        readers.emplace_back(
            [&]
            {
                do
                    read_all();
                while (!over);
            });
    start_runs(wanted ? std::stoi(wanted) : RUNS);
    over = true;
    for (auto& reader : readers)
        reader.join();
    wait_for_end();
    EXPECT_EQ(states(), before);
}

TEST_F(Life, a_run_leaves_nothing_but_its_records)
{
    const auto element = path("ZEMLAR_FCPort", 0);
    const auto runs = [&](int count)
    {
        for (int i = 0; i < count; ++i)
        {
            EXPECT_EQ(run(tests[0].test_class, tests[0].name, element).code, "4096");
            wait_for_end();
            hxasim::take_requests();
        }
    };
    runs(110); // fills the lists
    const sample::Resources held;
    runs(110);
    const sample::Resources after;
    EXPECT_EQ(after.threads, held.threads);
    EXPECT_EQ(after.descriptors, held.descriptors);
    EXPECT_LT(after.heap, held.heap + 4096);
}

TEST_F(Life, ends_of_the_broker_and_of_the_module_do_not_end_a_run)
{
    const std::string before = states();
    hxasim::set_time_scale(0.1);
    ASSERT_EQ(run(tests[1].test_class, tests[1].name, path("ZEMLAR_FCPort", 0)).code, "4096");
    unload();
    wait_for_end();
    load();
    EXPECT_EQ(states(), before);
    EXPECT_EQ(value(enumerate("ZEMLAR_ConcreteJob").at(0), "JobState"), "7");
}

TEST_F(Life, without_room_for_a_thread_there_is_no_job)
{
    const auto job = [] { return value(enumerate("ZEMLAR_ConcreteJob").at(0), "StartTime"); };
    const auto element = path("ZEMLAR_FCPort", 0);
    ASSERT_EQ(run(tests[0].test_class, tests[0].name, element).code, "4096");
    wait_for_end();
    const std::string before = job();

    pthread_attr_t usual;
    pthread_attr_t too_large;
    pthread_getattr_default_np(&usual);
    pthread_attr_init(&too_large);
    pthread_attr_setstacksize(&too_large, std::size_t{1} << 46);
    pthread_setattr_default_np(&too_large);
    const Answer refused = run(tests[0].test_class, tests[0].name, element);
    pthread_setattr_default_np(&usual);

    EXPECT_EQ(refused.code, "4");
    EXPECT_EQ(refused.job, "");
    EXPECT_EQ(job(), before);
    EXPECT_EQ(run(tests[0].test_class, tests[0].name, element).code, "4096");
}
