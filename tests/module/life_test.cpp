// Loading, many threads, unloading.
#include "tests/module/loaded_module.h"

#include <dlfcn.h>
#include <gmock/gmock.h>
#include <malloc.h>

#include <chrono>
#include <filesystem>
#include <thread>

namespace
{

std::size_t entries_of(const char* folder)
{
    const std::filesystem::directory_iterator entries(folder);
    return static_cast<std::size_t>(std::distance(begin(entries), end(entries)));
}

// Threads, descriptors and heap of this process.
struct Resources
{
    std::size_t threads = entries_of("/proc/self/task");
    std::size_t descriptors = entries_of("/proc/self/fd");
    std::size_t heap = mallinfo2().uordblks;

    bool operator==(const Resources&) const = default;
};

void PrintTo(const Resources& r, std::ostream* out)
{
    *out << r.threads << " threads, " << r.descriptors << " descriptors, " << r.heap << " bytes";
}

using Life = Loaded_Module;

// Rounds run in a thread of their own: what the allocator caches of freed blocks for a thread counts as used until the thread
// ends. A thread that was joined may be listed a moment longer.
template <class Round> void run(int rounds, Round round)
{
    const Resources before;
    std::thread runner(
        [&]
        {
            for (int i = 0; i < rounds; ++i)
                round();
        });
    runner.join();
    for (int i = 0; i < 1'000 && Resources().threads != before.threads; ++i)
        std::this_thread::sleep_for(std::chrono::milliseconds(1));
}

} // namespace

TEST_F(Life, unloading_leaves_nothing_behind)
{
    hxasim::load("mixed");
    const auto round = []
    {
        {
            cimserver::Module module(module_path);
            cimserver::Name_Spaces operations(module);
            EXPECT_GT(operations.enumerate_instances(name_space, "ZEMLAR_FCPort", true, std::nullopt).size(), 0U);
            hxasim::take_requests(); // what the simulator remembers is no leak
        }
        EXPECT_EQ(dlopen(module_path, RTLD_NOW | RTLD_NOLOAD), nullptr) << "the module is still mapped";
    };
    run(LOAD_ROUNDS / 10, round);
    const Resources before;
    run(LOAD_ROUNDS, round);
    EXPECT_EQ(Resources(), before);
}

// The very first requests are among them: they race to make the managers, the helpers and the providers.
TEST_F(Life, many_threads_ask_at_once)
{
    load("mixed");
    const char* const classes[] = {"ZEMLAR_FCPort", "ZEMLAR_PortController", "ZEMLAR_ComputerSystem", "CIM_LogicalDevice"};
    std::vector<std::size_t> expected;
    for (const char* name : classes)
        expected.push_back(enumerate(name).size());
    load("mixed");

    std::vector<std::thread> clients;
    for (int client = 0; client < 16; ++client)
        clients.emplace_back(
            [&, client]
            {
                for (int i = 0; i < 10; ++i)
                {
                    const auto which = static_cast<std::size_t>(client + i) % std::size(classes);
                    EXPECT_EQ(enumerate(classes[which]).size(), expected[which]);
                }
            });
    for (auto& client : clients)
        client.join();
}
