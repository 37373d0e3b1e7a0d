// Loading, many threads, unloading.

#include "tests/module/loaded_module.h"

#include <dirent.h>
#include <dlfcn.h>
#include <gmock/gmock.h>
#include <malloc.h>

#include <thread>

namespace
{

std::size_t open_descriptors()
{
    std::size_t count = 0;
    DIR* folder = opendir("/proc/self/fd");
    while (readdir(folder))
        ++count;
    closedir(folder);
    return count;
}

std::size_t threads()
{
    std::size_t count = 0;
    DIR* folder = opendir("/proc/self/task");
    while (readdir(folder))
        ++count;
    closedir(folder);
    return count;
}

class Life : public Loaded_Module
{
};

} // namespace

TEST_F(Life, UnloadingLeavesNothingBehind)
{
    hxasim::load("mixed");
    const auto round = []
    {
        cimserver::Module module(module_path);
        cimserver::Name_Spaces operations(module);
        EXPECT_GT(operations.enumerate_instances(name_space, "ZEMLAR_FCPort", true, std::nullopt).size(), 0U);
        hxasim::take_requests(); // what the simulator remembers is no leak
    };
    round();
    const auto descriptors = open_descriptors();
    const auto running = threads();
    const auto heap = mallinfo2().uordblks;
    for (int i = 0; i < LOAD_ROUNDS; ++i)
    {
        round();
        EXPECT_EQ(dlopen(module_path, RTLD_NOW | RTLD_NOLOAD), nullptr) << "the module is still mapped";
    }
    EXPECT_EQ(open_descriptors(), descriptors);
    EXPECT_EQ(threads(), running);
    EXPECT_LT(mallinfo2().uordblks, heap + 32 * LOAD_ROUNDS) << "less than anything that a load makes";
}

// The very first requests are among them: they race to make the managers, the helpers and the providers.
TEST_F(Life, ManyThreadsAskAtOnce)
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
