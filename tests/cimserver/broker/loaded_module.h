// A fixture with the test module loaded and its operations on top.
#pragma once

#include "cimserver/interop/name_spaces.h"
#include "test_module.h"

#include <dlfcn.h>
#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

namespace cimserver
{

// Keeps the test module in memory, whatever the server does, to ask it how it fares.
class Test_Module
{
public:
    explicit Test_Module(const std::string& file = TEST_MODULE) : _library(dlopen(file.c_str(), RTLD_NOW)) {}
    ~Test_Module() { dlclose(_library); }
    Test_Module(const Test_Module&) = delete;
    Test_Module& operator=(const Test_Module&) = delete;

    Test_Module_State& state() const
    {
        return *reinterpret_cast<decltype(&test_module_state)>(dlsym(_library, "test_module_state"))();
    }

private:
    void* _library;
};

class Loaded_Module : public ::testing::Test
{
protected:
    // Runs an operation that must fail; its CIM status, and the description through `description`.
    template <class Body> static int error_of(Body body, std::string* description = nullptr)
    {
        try
        {
            body();
        }
        catch (const Cim_Error& error)
        {
            if (description)
                *description = error.description();
            return error.code();
        }
        return 0;
    }

    static Object_Path path(const std::string& class_name, std::vector<Named_Value> keys)
    {
        return {"", "root/zemlar", class_name, std::move(keys)};
    }

    static Value text(const std::string& value) { return {CMPI_string, value}; }
    static std::vector<Named_Value> id(const std::string& value) { return {{"Id", text(value)}}; }

    std::vector<std::string> enumerate_ids(const std::string& class_name)
    {
        std::vector<std::string> result;
        for (const Object_Path& found : operations.enumerate_instance_names(class_name))
            result.push_back(found.class_name + ":" + std::get<std::string>(found.keys.at(0).value.content));
        return result;
    }

    Test_Module test_module;
    Module module{TEST_MODULE};
    Server_Name_Spaces name_spaces{module};
    Operations& operations = name_spaces.at("root/zemlar", "");
};

} // namespace cimserver
