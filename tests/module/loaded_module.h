// The module on a simulated host, behind the operations that a client may ask for.
#pragma once

#include "cimserver/broker/module.h"
#include "cimserver/interop/name_spaces.h"
#include "sim/hxasim.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

extern const char* const module_path;

inline constexpr const char* name_space = "root/zemlar";

// The text of a string property; "(null)" when it is null, "(none)" when the instance has no such property.
std::string text_of(const cimserver::Instance& instance, const std::string& property);

// The class name, then a line for each property that is not null, in the order of the class.
std::string describe(const cimserver::Instance& instance);

class Loaded_Module : public testing::Test
{
protected:
    // Loads the module anew on a shipped scenario.
    void load(const std::string& scenario);

    // The instances of a class, asked for as a client would.
    std::vector<cimserver::Instance> enumerate(const std::string& class_name);

    // The names of the requests since the last call, in order.
    static std::vector<std::string> requests();

    // Every test also fails on requests that no driver would accept.
    void TearDown() override;

    cimserver::Module& module() { return *_module; }
    cimserver::Operations& operations() { return _name_spaces->at(name_space, ""); }

private:
    void unload();

    std::unique_ptr<cimserver::Module> _module;
    std::unique_ptr<cimserver::Server_Name_Spaces> _name_spaces;
};
