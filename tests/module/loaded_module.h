// The module on a simulated host, behind the operations that a client may ask for.
#pragma once

#include "cimserver/broker/module.h"
#include "cimserver/interop/name_spaces.h"
#include "tests/support/simulated_host.h"

#include <memory>
#include <string>
#include <vector>

extern const char* const module_path;

inline constexpr const char* name_space = "root/zemlar";

class Loaded_Module : public Simulated_Host
{
protected:
    // Loads the module anew on a shipped scenario.
    void load(const std::string& scenario);

    // The instances of a class, asked for as a client would.
    std::vector<cimserver::Instance> enumerate(const std::string& class_name);

    cimserver::Module& module() { return *_module; }
    cimserver::Operations& operations() { return _name_spaces->at(name_space, ""); }

private:
    void unload();

    std::unique_ptr<cimserver::Module> _module;
    std::unique_ptr<cimserver::Server_Name_Spaces> _name_spaces;
};
