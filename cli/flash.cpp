#include "hxal/flash.h"
#include "cli/commands.h"
#include "cli/field_text.h"
#include "cli/host.h"
#include "cli/report.h"
#include "cli/words.h"
#include "hxal/boot.h"
#include "hxal/value_names.h"

#include <unistd.h>

#include <algorithm>

namespace hxa
{

namespace
{

// clang-format off
constexpr Column columns[] = {
    {"Adapter",   "adapter"},
    {"Partition", "type"},
    {"Instance",  "instance"},
    {"Offset",    "offset_bytes"},
    {"Size",      "size_bytes", " B"},
    {"Used",      "used_bytes", " B"},
    {"Status",    "status"},
};

constexpr Column version_columns[] = {
    {"Adapter",    "adapter"},
    {"Firmware",   "firmware_version"},
    {"Option ROM", "option_rom_version"},
    {"BIOS",       "bios_version"},
    {"EFI",        "efi_version"},
    {"Open Boot",  "open_boot_version"},
};
// clang-format on

List partitions(const Adapter& adapter, const hxa_flash_attr_t& attr)
{
    List rows;
    for (const auto& part : std::span(attr.part).first(std::min<std::size_t>(attr.npart, HXA_FLASH_PART_MAX)))
        rows.push_back(Object{{"adapter", adapter.number},
                              {"type", hxal_flash_part_type_to_string(part.part_type)},
                              {"instance", part.part_instance},
                              {"offset_bytes", part.part_off},
                              {"size_bytes", part.part_size},
                              {"used_bytes", part.part_len},
                              {"status", hxal_flash_status_to_string(part.part_status)}});
    return rows;
}

Value versions(Session& session, const Adapter& adapter)
{
    Object tree{{"adapter", adapter.number}};
    hxa_ioc_attr_t attr{};
    if (session.accept(hxal_ioc_get_attr(adapter.ioc(), &attr), "adapter " + adapter.name()))
        for (auto& member : Object{{"firmware_version", field_text(attr.adapter_attr.fw_ver)},
                                   {"option_rom_version", field_text(attr.adapter_attr.optrom_ver)},
                                   {"bios_version", field_text(attr.driver_attr.bios_ver)},
                                   {"efi_version", field_text(attr.driver_attr.efi_ver)},
                                   {"open_boot_version", field_text(attr.driver_attr.ob_ver)}})
            tree.push_back(member);
    return tree;
}

void show(Session& session, const std::vector<Adapter>& adapters)
{
    List all_versions, all_partitions;
    for (const auto& adapter : adapters)
    {
        all_versions.push_back(versions(session, adapter));
        hxa_flash_attr_t attr{};
        if (session.accept(hxal_flash_get_attr(adapter.ioc(), &attr), "flash of adapter " + adapter.name()))
            for (const auto& row : partitions(adapter, attr))
                all_partitions.push_back(row);
    }
    session.answer(Object{{"versions", all_versions}, {"partitions", all_partitions}},
                   table(all_versions, version_columns) + '\n' + table(all_partitions, columns));
}

// A partition that the card lists, by the word for its type and its instance.
struct Partition
{
    hxa_flash_part_type_t type;
    std::uint8_t instance;
    std::uint32_t size;
    std::string name;
};

Partition partition(const Adapter& adapter, const std::string& text)
{
    hxa_flash_attr_t attr{};
    require(hxal_flash_get_attr(adapter.ioc(), &attr), "flash of adapter " + adapter.name());
    for (const auto& part : std::span(attr.part).first(std::min<std::size_t>(attr.npart, HXA_FLASH_PART_MAX)))
    {
        const std::string type = hxal_flash_part_type_to_string(part.part_type);
        const auto name = type + '/' + std::to_string(part.part_instance);
        if ((text == type || text == name) && part.part_instance <= 0xFF)
            return {static_cast<hxa_flash_part_type_t>(part.part_type), static_cast<std::uint8_t>(part.part_instance),
                    part.part_size, "partition " + name + " of adapter " + adapter.name()};
    }
    throw Failure(Exit::no_such_element, "adapter " + adapter.name() + " has no partition \"" + safe_text(text) + '"');
}

void update(Session& session, const Host& host, const Flash_Options& options)
{
    const bool all = options.adapter == "all";
    const auto what = all ? "every adapter" : "adapter " + host.adapter(options.adapter).name();
    session.confirm("The boot code and firmware images of " + safe_text(options.file) + " are written to the flash of " + what +
                    ". Leave the power on until it is done.");
    const auto* ioc = all ? nullptr : host.adapter(options.adapter).ioc();
    require(hxal_boot_fwupdate(ioc, options.file.c_str(), 0), "update of " + what);
}

void act_on_partition(Session& session, const Adapter& adapter, const Flash_Options& options)
{
    const auto part = partition(adapter, options.partition);
    if (options.action == "read")
    {
        if (access(options.file.c_str(), F_OK) == 0)
            session.confirm(safe_text(options.file) + " is replaced by what " + part.name + " holds.");
        std::string file = options.file;
        return require(hxal_flash_read_part(adapter.ioc(), part.type, part.instance, file.data(), part.size, HXA_TRUE),
                       part.name);
    }
    if (options.action == "erase")
    {
        session.confirm("What " + part.name + " holds is lost.");
        return require(hxal_flash_erase_part(adapter.ioc(), part.type, part.instance), part.name);
    }
    session.confirm("What " + part.name + " holds is replaced by " + safe_text(options.file) + ".");
    require(hxal_flash_update_part(adapter.ioc(), part.type, part.instance,
                                   reinterpret_cast<const unsigned char*>(options.file.c_str()), HXA_TRUE, 0),
            part.name);
}

void switch_option_rom(Session& session, const Adapter& adapter, const std::string& value)
{
    const bool on = read_switch(value);
    session.confirm("The option ROM switch in the flash of adapter " + adapter.name() + " is turned " + value +
                    (on ? "." : ": the host cannot boot from it."));
    require(on ? hxal_flash_enable_optrom(adapter.ioc()) : hxal_flash_disable_optrom(adapter.ioc()),
            "option ROM of adapter " + adapter.name());
}

} // namespace

void flash(Session& session, const Flash_Options& options)
{
    const Host host(session);
    if (options.action == "show")
        return show(session, host.adapters(options.adapter));
    if (options.action == "update")
        update(session, host, options);
    else if (options.action == "option-rom")
        switch_option_rom(session, host.adapter(options.adapter), options.value);
    else
        act_on_partition(session, host.adapter(options.adapter), options);
    session.answer_change("adapter", options.adapter, options.action, options.value + options.partition);
}

} // namespace hxa
