// A simulated host and the module loaded on it.
#pragma once

#include "cimserver/broker/module.h"
#include "cimserver/interop/name_spaces.h"

#include <memory>
#include <string>

namespace bench
{

// The path of the built module.
extern const char* const module_path;

// The scenario of a host with so many two-port FC HBAs.
std::string two_port_hbas(int adapters);

// The module loaded on the scenario's host (JSON text), and the operations it answers.
class Simulated_Host
{
public:
    explicit Simulated_Host(const std::string& scenario);

    cimserver::Module& module() { return *_module; }
    cimserver::Operations& operations() { return _name_spaces->at("root/zemlar", ""); }

private:
    std::unique_ptr<cimserver::Module> _module;
    std::unique_ptr<cimserver::Server_Name_Spaces> _name_spaces;
};

} // namespace bench
