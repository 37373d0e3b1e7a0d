// Loading and unloading a module.
#include "loaded_module.h"

#include <unistd.h>

#include <filesystem>

namespace cimserver
{
namespace
{

bool is_loaded(const std::string& file)
{
    void* library = dlopen(file.c_str(), RTLD_NOW | RTLD_NOLOAD);
    if (library)
        dlclose(library);
    return library != nullptr;
}

TEST(Module_Loading, cleans_its_interfaces_up_and_unloads)
{
    {
        const Test_Module test_module;
        {
            Module module(TEST_MODULE);
            Server_Name_Spaces name_spaces(module);
            Operations& operations = name_spaces.at("root/zemlar", "");
            EXPECT_EQ(test_module.state().live_interfaces, 0);
            operations.enumerate_instance_names("TST_Disk");
            operations.enumerate_instance_names("TST_Disk");
            EXPECT_EQ(test_module.state().live_interfaces, 1);
            operations.enumerate_instance_names("TST_Base");
            EXPECT_EQ(test_module.state().live_interfaces, 2);

            module.close();
            EXPECT_EQ(test_module.state().live_interfaces, 0);
            EXPECT_THROW(operations.enumerate_instance_names("TST_Disk"), Cim_Error);
        }
        EXPECT_EQ(test_module.state().live_interfaces, 0);
    }
    EXPECT_FALSE(is_loaded(TEST_MODULE));
}

// A copy of the module: it stays for good, and other tests rely on one that is loaded anew.
TEST(Module_Loading, leaves_a_module_in_memory_that_asks_for_it)
{
    const std::string copy = ::testing::TempDir() + "lasting_module-" + std::to_string(getpid()) + ".so";
    std::filesystem::copy_file(TEST_MODULE, copy);
    {
        const Test_Module test_module(copy);
        test_module.state().cleanup_rc = CMPI_RC_NEVER_UNLOAD;
        Module module(copy);
        Server_Name_Spaces name_spaces(module);
        name_spaces.at("root/zemlar", "").enumerate_instance_names("TST_Disk");
    }
    EXPECT_TRUE(is_loaded(copy));
    std::filesystem::remove(copy);
}

} // namespace
} // namespace cimserver
