#include "tests/inventory/inventory_fixture.h"

#include "hxal/hxal.h"
#include "inventory/property_text.h"
#include "runtime/print.h"
#include "tests/runtime/home.h"
#include "tests/runtime/printed.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>

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

    // The management agent that another test starts is none of this host's: no process is seen.
    std::filesystem::create_symlink("/bin/true", home().path("ps"));
    setenv("PATH", (home().path("") + ':' + getenv("PATH")).c_str(), 1);
}

std::string text_of(const Instance* instance, const Meta_Property* property)
{
    if (null_of(instance, property))
        return {};
    const void* value = address_of(instance, property->offset);
    if (property->type == STRING && property->subscript == 0)
    {
        const String& text = *static_cast<const String*>(value);
        EXPECT_TRUE(property_text(text.c_str(), text.size()) == text) << property->name << " is what no client can be sent";
    }
    const auto print = property->subscript ? print_array : print_scalar;
    return printed([&](FILE* stream) { print(stream, static_cast<Type>(property->type), value); });
}

} // namespace

void Inventory_Test::SetUp()
{
    fake_host = Fake_Host();
    hxasim::load("mixed");
    scan();
}

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

std::vector<std::string> Inventory_Test::log(bool entries)
{
    static std::ifstream messages;
    if (!messages.is_open())
        messages.open(home().path(".cimple/messages"));
    messages.clear();

    std::vector<std::string> lines; // "date time LEVEL: Source(line): message"
    for (std::string line; std::getline(messages, line);)
    {
        const auto level = line.find(' ', line.find(' ') + 1) + 1, source = line.find(": ", level),
                   number = line.find('(', source), end = line.find("): ", number);
        const std::string message = end == line.npos ? line : line.substr(end + 3);
        if (end == line.npos)
            lines.push_back(line);
        else if ((entries || !message.starts_with("Entering: ")) && !message.starts_with("Returning: "))
            lines.push_back(line.substr(level, source - level) + line.substr(source + 1, number - source - 1) + ": " + message);
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

} // namespace zmlr
