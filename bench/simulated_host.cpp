#include "bench/simulated_host.h"

#include "sim/hxasim.h"

#include <string>

namespace bench
{

const char* const module_path = ZMLR_MODULE_PATH;

void simulate(int adapters)
{
    hxasim::load_text(R"({"generate": {"kind": "fc-hba", "ports": 2, "adapters": )" + std::to_string(adapters) + "}}");
}

Simulated_Host::Simulated_Host(int adapters)
{
    simulate(adapters);
    _module = std::make_unique<cimserver::Module>(module_path);
    _name_spaces = std::make_unique<cimserver::Server_Name_Spaces>(*_module);
}

} // namespace bench
