#include "cli/commands.h"
#include "cli/config_settings.h"
#include "cli/field_text.h"
#include "cli/host.h"
#include "cli/keep.h"
#include "cli/report.h"
#include "hxal/config/parser.h"
#include "hxal/config/writer.h"
#include "hxal/value_names.h"

#include <cstring>

namespace hxa
{

namespace
{

constexpr Column columns[] = {{"Element", "element"}, {"Name", "id"}, {"Setting", "setting"}, {"Value", "value"}};

bool has(const std::uint32_t (&flags)[4], int code) { return flags[code / 32] >> code % 32 & 1; }

// The port with this entry, or "-": the file may tell of cards that are not in the host.
Value port_name(const Host& host, const hxal_ioc_config_t& entry)
{
    const auto wwn = read_wwn(entry.pwwn);
    const auto mac = read_mac(entry.mac);
    for (const auto& port : host.ports())
        if ((wwn && port.fc && port.fc->pwwn == *wwn) ||
            (mac && port.ethernet && std::memcmp(&port.ethernet->mac, &*mac, sizeof *mac) == 0))
            return "port " + port.name();
    return {};
}

Value adapter_name(const Host& host, const std::string& serial)
{
    for (const auto& adapter : host.adapters())
        if (field_text(adapter.handle->serial_num) == serial)
            return "adapter " + adapter.name();
    return {};
}

void add_adapter(const Host& host, const hxal_ad_config_t& entry, List& rows)
{
    const auto serial = field_text(entry.id);
    const auto add = [&](const char* setting, Value value)
    {
        rows.push_back(
            Object{{"element", adapter_name(host, serial)}, {"id", serial}, {"setting", setting}, {"value", std::move(value)}});
    };
    if (has(entry.flags, HXAL_CONFIG_AD_NAME))
        add("name", field_text(entry.name));
    if (has(entry.flags, HXAL_CONFIG_AD_POWER))
        add("power", hxal_pm_ds_to_string(entry.power));
}

// As the file has it.
std::string virtual_port_text(const hxal_vf_config_t& vport)
{
    std::string text;
    for (const auto& field : {field_text(vport.pwwn), field_text(vport.nwwn), field_text(vport.name), field_text(vport.role)})
        text += field + ',';
    return text + std::to_string(vport.vf_id);
}

void add_port(const Host& host, const hxal_ioc_config_t& entry, List& rows)
{
    const auto id = field_text(has(entry.flags, HXAL_CONFIG_PORT_WWN) ? entry.pwwn : entry.mac);
    for (const auto& setting : settings())
        if (has(entry.flags, setting.code))
            rows.push_back(Object{
                {"element", port_name(host, entry)}, {"id", id}, {"setting", setting.name}, {"value", setting.show(entry)}});
    for (const auto* vport = entry.vport; vport; vport = vport->next)
        rows.push_back(Object{{"element", port_name(host, entry)},
                              {"id", id},
                              {"setting", "vport-" + std::to_string(vport->vidx)},
                              {"value", virtual_port_text(*vport)}});
}

void show(Session& session, const Host& host)
{
    List rows;
    const auto* model = hxal_config_get();
    for (const auto& entry : model->adapters)
        add_adapter(host, entry, rows);
    for (const auto& entry : model->iocs)
        add_port(host, entry, rows);
    session.answer(Object{{"settings", rows}}, table(rows, columns));
}

int entry_of(const Port& port)
{
    const int index = port.fc ? hxal_config_ioc_lookup(port.fc->pwwn) : hxal_config_ethioc_lookup(port.ethernet->mac);
    if (index < 0)
        throw Failure(Exit::no_such_element, "the configuration has no entry for port " + port.name());
    return index;
}

// Stores the value as the file's grammar reads it, and sees whether it understood it as it was meant.
void set(const Port& port, const Setting& setting, const std::string& value)
{
    const int index = entry_of(port);
    check_value(setting, value);
    hxal_config_set_data(setting.code, index, value.c_str());
    if (!has(hxal_config_get()->iocs[index].flags, setting.code))
        throw Failure(Exit::usage, '"' + safe_text(value) + "\" is no value of " + setting.name + ": " + setting.values);
}

} // namespace

void config(Session& session, const Config_Options& options)
{
    const Host host(session);
    hxal_config_load(options.file.c_str());
    if (options.action == "show")
        return show(session, host);
    if (options.action == "set")
        set(host.port(options.port), setting_named(options.setting), options.value);
    confirm_rewriting(session, options.file);
    require(hxal_config_sync(options.file.c_str()), safe_text(options.file));
    session.answer_change("file", safe_text(options.file), options.action, options.setting);
}

} // namespace hxa
