// A simulated host with a given number of two-port FC HBAs and the module loaded on it.
#pragma once

#include "cimserver/broker/module.h"
#include "cimserver/interop/name_spaces.h"

#include <memory>

namespace bench
{

// The path of the built module.
extern const char* const module_path;

// Replaces the simulated host: `adapters` two-port FC HBAs. A module loaded before keeps what it saw at load.
void simulate(int adapters);

// The module loaded on such a host and the operations it answers.
class Simulated_Host
{
public:
    explicit Simulated_Host(int adapters);

    cimserver::Operations& operations() { return _name_spaces->at("root/zemlar", ""); }

private:
    std::unique_ptr<cimserver::Module> _module;
    std::unique_ptr<cimserver::Server_Name_Spaces> _name_spaces;
};

} // namespace bench
