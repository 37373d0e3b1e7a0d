#include "bench/simulated_host.h"

#include "sim/hxasim.h"

namespace bench
{

const char* const module_path = ZMLR_MODULE_PATH;

std::string two_port_hbas(int adapters)
{
    return R"({"generate": {"kind": "fc-hba", "ports": 2, "adapters": )" + std::to_string(adapters) + "}}";
}

Simulated_Host::Simulated_Host(const std::string& scenario)
{
    hxasim::load_text(scenario);
    _module = std::make_unique<cimserver::Module>(module_path);
    _name_spaces = std::make_unique<cimserver::Server_Name_Spaces>(*_module);
}

} // namespace bench
