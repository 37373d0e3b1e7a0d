#include "tests/inventory/inventory_fixture.h"

#include "hxal/hxal.h"
#include "runtime/print.h"
#include "tests/runtime/home.h"
#include "tests/runtime/printed.h"

#include <cstdlib>
#include <fstream>
#include <regex>

namespace zmlr
{

namespace
{

const sample::Home& home()
{
    static const sample::Home home;
    return home;
}

// Before any static object: the first of them already probes the driver and logs.
[[gnu::constructor(101)]] void prepare_home()
{
    home().options("LOG_LEVEL=DBG\n");
    setenv("HOME", home().path("").c_str(), 1);
    setenv("HXASIM_SCENARIO", "mixed", 0);
}

std::string text_of(const Instance* instance, const Meta_Property* property)
{
    if (null_of(instance, property))
        return {};
    const auto print = property->subscript ? print_array : print_scalar;
    return printed([&](FILE* stream)
                   { print(stream, static_cast<Type>(property->type), address_of(instance, property->offset)); });
}

} // namespace

void Inventory_Test::SetUp()
{
    fake_host = Fake_Host();
    hxasim::load("mixed");
    scan();
}

void Inventory_Test::TearDown() { EXPECT_THAT(hxasim::violations(), testing::IsEmpty()); }

void Inventory_Test::plug_text(const std::string& json)
{
    hxasim::load_text(json);
    scan();
}

void Inventory_Test::scan()
{
    hxal_adapter_scan();
    requests();
    log();
}

std::vector<std::string> Inventory_Test::requests()
{
    std::vector<std::string> texts;
    for (const hxasim::Request& request : hxasim::take_requests())
        texts.push_back(request.name + ' ' + request.node + ' ' + std::to_string(request.instance));
    return texts;
}

std::vector<std::string> Inventory_Test::log()
{
    static std::ifstream messages;
    if (!messages.is_open())
        messages.open(home().path(".cimple/messages"));
    messages.clear();

    static const std::regex form(R"(\S+ \S+ (\w+): (\w+)\(\d+\): (.*))");
    std::vector<std::string> lines;
    for (std::string line; std::getline(messages, line);)
    {
        std::smatch part;
        if (!std::regex_match(line, part, form))
            lines.push_back(line);
        else if (!part[3].str().starts_with("Entering: ") && !part[3].str().starts_with("Returning: "))
            lines.push_back(part[1].str() + ' ' + part[2].str() + ": " + part[3].str());
    }
    return lines;
}

std::string value_of(const Instance* instance, const char* property)
{
    return text_of(instance, find_property(instance->meta_class, property));
}

std::vector<std::string> values_of(const Instance_Array& instances, const char* property)
{
    std::vector<std::string> texts;
    for (const Instance* instance : instances)
        texts.push_back(value_of(instance, property));
    return texts;
}

std::string describe(const Instance* instance)
{
    const Meta_Class* meta_class = instance->meta_class;
    std::string text = std::string(meta_class->name) + '\n';
    for (uint32 i = 0; i < meta_class->num_meta_features; i++)
    {
        const Meta_Feature* feature = meta_class->meta_features[i];
        const std::string value = is_property(feature) ? text_of(instance, as_property(feature)) : std::string();
        if (!value.empty())
            text += std::string("    ") + feature->name + " = " + value + '\n';
    }
    return text;
}

std::string describe(const Instance_Array& instances)
{
    std::string text;
    for (const Instance* instance : instances)
        text += describe(instance);
    return text;
}

} // namespace zmlr
