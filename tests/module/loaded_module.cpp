#include "tests/module/loaded_module.h"

const char* const module_path = ZMLR_MODULE_PATH;

void Loaded_Module::load(const std::string& scenario)
{
    unload();
    hxasim::load(scenario);
    _module = std::make_unique<cimserver::Module>(module_path);
    _name_spaces = std::make_unique<cimserver::Server_Name_Spaces>(*_module);
}

// A module that is still mapped would not look at the new host.
void Loaded_Module::unload()
{
    _name_spaces.reset();
    _module.reset();
}

std::vector<cimserver::Instance> Loaded_Module::enumerate(const std::string& class_name)
{
    return operations().enumerate_instances(class_name, true, std::nullopt);
}
