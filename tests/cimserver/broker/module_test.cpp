// Loading and unloading a module.
#include "loaded_module.h"

#include <gmock/gmock.h>

#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <stdexcept>

namespace cimserver
{
namespace
{

using ::testing::HasSubstr;

bool is_loaded(const std::string& file)
{
    void* library = dlopen(file.c_str(), RTLD_NOW | RTLD_NOLOAD);
    if (library)
        dlclose(library);
    return library != nullptr;
}

std::string load_error(const std::string& file)
{
    try
    {
        const Module module(file);
    }
    catch (const std::runtime_error& error)
    {
        return error.what();
    }
    return "";
}

TEST(Module_Loading, tells_why_a_file_is_no_module)
{
    EXPECT_THAT(load_error("/nowhere/libnothing.so"), HasSubstr("/nowhere/libnothing.so: cannot open"));
    EXPECT_THAT(load_error(NO_MODULE), HasSubstr("has no function cimple_module"));

    const std::string text_file = ::testing::TempDir() + "cimserver_no_library.so";
    std::ofstream(text_file) << "not a library";
    EXPECT_THAT(load_error(text_file), HasSubstr(text_file));
}

TEST(Module_Loading, cleans_its_interfaces_up_and_unloads)
{
    {
        const Test_Module test_module;
        {
            Module module(TEST_MODULE);
            Name_Spaces operations(module);
            EXPECT_EQ(test_module.state().live_interfaces, 0);
            operations.enumerate_instance_names("root/zemlar", "TST_Disk");
            operations.enumerate_instance_names("root/zemlar", "TST_Disk");
            EXPECT_EQ(test_module.state().live_interfaces, 1);
            operations.enumerate_instance_names("root/zemlar", "TST_Base");
            EXPECT_EQ(test_module.state().live_interfaces, 2);

            module.close();
            EXPECT_EQ(test_module.state().live_interfaces, 0);
            EXPECT_THROW(operations.enumerate_instance_names("root/zemlar", "TST_Disk"), Cim_Error);
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
        Name_Spaces operations(module);
        operations.enumerate_instance_names("root/zemlar", "TST_Disk");
    }
    EXPECT_TRUE(is_loaded(copy));
    std::filesystem::remove(copy);
}

} // namespace
} // namespace cimserver
