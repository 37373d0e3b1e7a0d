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

namespace
{

std::string text_of(const cimserver::Value& value)
{
    if (const auto* text = std::get_if<std::string>(&value.content))
        return '"' + *text + '"';
    if (const auto* number = std::get_if<std::uint64_t>(&value.content))
        return std::to_string(*number);
    std::string texts;
    for (const auto& element : std::get<std::vector<cimserver::Value>>(value.content))
        texts += (texts.empty() ? "" : ", ") + text_of(element);
    return '{' + texts + '}';
}

} // namespace

std::string describe(const cimserver::Instance& instance)
{
    std::string text = instance.path.class_name + '\n';
    for (const auto& [name, value] : instance.properties)
        if (!value.null())
            text += "    " + name + " = " + text_of(value) + '\n';
    return text;
}

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
    unload();
    hxasim::unload();
}
