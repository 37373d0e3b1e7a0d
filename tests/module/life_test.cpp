// Loading, many threads, unloading.
#include "tests/module/loaded_module.h"
#include "tests/runtime/resources.h"

#include <cmpift.h>
#include <dlfcn.h>
#include <unistd.h>

#include <filesystem>

namespace
{

using Life = Loaded_Module;

} // namespace

TEST_F(Life, unloading_leaves_nothing_behind)
{
    hxasim::load("mixed");
    const auto round = []
    {
        {
            cimserver::Module module(module_path);
            cimserver::Server_Name_Spaces name_spaces(module);
            EXPECT_GT(name_spaces.at(name_space, "").enumerate_instances("ZEMLAR_FCPort", true, std::nullopt).size(), 0U);
            hxasim::take_requests(); // what the simulator remembers is no leak
        }
        EXPECT_EQ(dlopen(module_path, RTLD_NOW | RTLD_NOLOAD), nullptr) << "the module is still mapped";
    };
    sample::repeat(LOAD_ROUNDS / 10, round);
    const sample::Resources before;
    sample::repeat(LOAD_ROUNDS, round);
    EXPECT_EQ(sample::Resources(), before);
}

// A copy of the module: it stays for good, and other tests rely on one that is loaded anew.
TEST_F(Life, a_module_that_asks_for_it_stays_in_memory)
{
    const std::string copy = testing::TempDir() + "lasting_module-" + std::to_string(getpid()) + ".so";
    std::filesystem::copy_file(module_path, copy);
    {
        cimserver::Module module(copy);
        CMPIInstanceMI* mi = module.instance_mi(*module.repository().find("ZEMLAR_ComputerSystem"));
        static CMPIInstanceMIFT table = *mi->ft;
        table.cleanup = [](CMPIInstanceMI*, const CMPIContext*, CMPIBoolean) {
            return CMPIStatus{CMPI_RC_NEVER_UNLOAD, nullptr};
        };
        mi->ft = &table;
        module.close();
        EXPECT_THROW(cimserver::Module::Use use(module), cimserver::Cim_Error);
    }
    EXPECT_NE(dlopen(copy.c_str(), RTLD_NOW | RTLD_NOLOAD), nullptr);
    std::filesystem::remove(copy);
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
