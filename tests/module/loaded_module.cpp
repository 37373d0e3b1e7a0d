#include "tests/module/loaded_module.h"

#include <gmock/gmock.h>

const char* const module_path = ZMLR_MODULE_PATH;

std::string text_of(const cimserver::Instance& instance, const std::string& property)
{
    for (const auto& [name, value] : instance.properties)
        if (name == property)
            return value.null() ? "(null)" : std::get<std::string>(value.content);
    return "(none)";
}

void Loaded_Module::load(const std::string& scenario)
{
    hxasim::load(scenario);
    load_module();
}

void Loaded_Module::load_text(const std::string& json)
{
    hxasim::load_text(json);
    load_module();
}

void Loaded_Module::load_module()
{
    _module = std::make_unique<cimserver::Module>(module_path);
    _operations = std::make_unique<cimserver::Module_Operations>(*_module);
}

std::vector<cimserver::Instance> Loaded_Module::enumerate(const std::string& class_name)
{
    return operations().enumerate_instances(name_space, class_name, true, std::nullopt);
}

std::vector<std::string> Loaded_Module::requests()
{
    std::vector<std::string> names;
    for (const auto& request : hxasim::take_requests())
        names.push_back(request.name);
    return names;
}

void Loaded_Module::TearDown()
{
    EXPECT_THAT(hxasim::violations(), testing::IsEmpty());
    _operations.reset();
    _module.reset();
    hxasim::unload();
}
