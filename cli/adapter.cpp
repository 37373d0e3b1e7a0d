#include "cli/commands.h"
#include "cli/field_text.h"
#include "cli/keep.h"
#include "cli/report.h"
#include "cli/trees.h"
#include "cli/words.h"
#include "hxal/value_names.h"

namespace hxa
{

namespace
{

// clang-format off
constexpr Column columns[] = {
    {"Adapter",         "adapter"},
    {"Model",           "model"},
    {"Description",     "description"},
    {"Manufacturer",    "manufacturer"},
    {"Serial number",   "serial_number"},
    {"Name",            "name"},
    {"Hardware path",   "hardware_path"},
    {"Hardware",        "hardware_version"},
    {"Firmware",        "firmware_version"},
    {"Option ROM",      "option_rom_version"},
    {"BIOS",            "bios_version"},
    {"EFI",             "efi_version"},
    {"Open Boot",       "open_boot_version"},
    {"Maximum speed",   "max_speed_gbps", " Gbit/s"},
    {"PCIe generation", "pcie_generation"},
    {"PCIe lanes",      "pcie_lanes"},
    {"Mezzanine card",  "mezzanine"},
    {"Converged",       "converged"},
};

constexpr Column list_columns[] = {
    {"Adapter", "adapter"}, {"Model", "model"}, {"Serial", "serial_number"}, {"Name", "name"}, {"Firmware", "firmware_version"},
};
// clang-format on

void show(Session& session, const std::vector<Adapter>& adapters)
{
    List trees;
    std::string text;
    for (const auto& adapter : adapters)
    {
        trees.push_back(adapter_tree(session, adapter));
        text += (text.empty() ? "" : "\n") + details(trees.back(), columns);
    }
    session.answer(Object{{"adapters", trees}}, text);
}

void list_adapters(Session& session, const std::vector<Adapter>& adapters)
{
    List trees;
    for (const auto& adapter : adapters)
        trees.push_back(adapter_tree(session, adapter));
    session.answer(Object{{"adapters", trees}}, table(trees, list_columns));
}

hxa_pm_ds_t power_state(const std::string& text)
{
    for (const auto state : {HXA_PM_DS_D0, HXA_PM_DS_D1, HXA_PM_DS_D2, HXA_PM_DS_D3})
        if (text == hxal_pm_ds_to_string(state))
            return state;
    throw Failure(Exit::usage, "\"" + safe_text(text) + "\" is no power state: full, save1, save2 or off");
}

void set_name(const Adapter& adapter, const std::string& name)
{
    hxal_adapter_set_name(static_cast<unsigned>(adapter.number), name.c_str());
    require(hxal_get_last_error(), "name of adapter " + adapter.name());
}

void act(Session& session, const Adapter& adapter, const Adapter_Options& options)
{
    const auto what = "adapter " + adapter.name();
    const auto ports = std::to_string(ports_of(adapter).size()) + " ports";
    if (options.action == "enable")
        require(hxal_adapter_enable(adapter.number), what);
    else if (options.action == "disable")
    {
        session.confirm("Adapter " + adapter.name() + " stops, and its " + ports + " lose their links.");
        require(hxal_adapter_disable(adapter.number), what);
    }
    else if (options.action == "name")
    {
        check_name(options.value, sizeof adapter.handle->name - 1);
        change(session, options.keep, [&] { set_name(adapter, options.value); });
    }
    else
    {
        const auto state = power_state(options.value);
        if (state != HXA_PM_DS_D0)
            session.confirm("Adapter " + adapter.name() + " goes into power state " + options.value + ", and its " + ports +
                            " may lose their links.");
        change(session, options.keep, [&] { require(hxal_adapter_set_power(adapter.handle, state), what); });
    }
    session.answer_change("adapter", adapter.name(), options.action, options.value);
}

} // namespace

void adapter(Session& session, const Adapter_Options& options)
{
    const Host host(session);
    if (options.action == "list")
        list_adapters(session, host.adapters());
    else if (options.action == "show")
        show(session, host.adapters(options.adapter));
    else
        act(session, host.adapter(options.adapter), options);
}

} // namespace hxa
