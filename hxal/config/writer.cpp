#include "hxal/config/writer.h"

#include "hxal/config/internal/settings.h"
#include "hxal/config/internal/syntax.h"

#include <cstring>

namespace
{

using namespace hxal::config;

// A heading and the settings below it: first those for all instances, then those of each instance. HXAL_CONFIG_AD_SERIAL, which
// is 0, ends a list.
struct Section
{
    const char* heading;
    hxal_config_code_t codes[5];
};

// clang-format off
constexpr Section sections[] = {
    {"\n#\n# Persistent naming of port\n#\n",
     {HXAL_CONFIG_PORT_WWN, HXAL_CONFIG_PORT_NAME, HXAL_CONFIG_PORT_MAC, HXAL_CONFIG_ETH_NAME}},
    {"\n#\n# Port configuration\n#\n",
     {HXAL_CONFIG_PORT_SPEED, HXAL_CONFIG_PORT_TOPOLOGY, HXAL_CONFIG_PORT_HARDALPA, HXAL_CONFIG_PORT_MAXFRSIZE}},
    {"\n# trunking\n",
     {HXAL_CONFIG_PORT_TRUNK}},
    {"\n# disable a port persistently\n",
     {HXAL_CONFIG_PORT_ENABLE}},
    {"",
     {HXAL_CONFIG_IPFC_ENABLE}},
    {"\n#\n# Driver log level\n# level: INFO, WARN, ERROR, CRITICAL\n#\n",
     {HXAL_CONFIG_LOG_LEVEL}},
    {"\n#\n# VF configuration\n#\n",
     {HXAL_CONFIG_VF_ENABLE, HXAL_CONFIG_VF_DEFAULT, HXAL_CONFIG_VF_LIST}},
    {"\n#\n# vport configuration\n#\n# vport-<id> = pwwn, nwwn, symname, roles [, vf_id]\n#\n",
     {HXAL_CONFIG_VPORT}},
    {"\n#\n# Authentication\n#\n",
     {HXAL_CONFIG_AUTH_POLICY, HXAL_CONFIG_AUTH_ALGO, HXAL_CONFIG_AUTH_GROUP, HXAL_CONFIG_AUTH_SECRETSOURCE,
      HXAL_CONFIG_AUTH_ENCRYPT}},
    {"\n#\n# Initiator mode configuration\n#\n",
     {HXAL_CONFIG_PATHTOV, HXAL_CONFIG_QDEPTH, HXAL_CONFIG_PERSISTENT_BINDING}},
    {"\n#\n# QoS, rate limiting configuration\n#\n",
     {HXAL_CONFIG_QOS, HXAL_CONFIG_RATELIM, HXAL_CONFIG_RATELIM_DEFSPEED}},
    {"\n#\n# IOC intr configuration\n#\n",
     {HXAL_CONFIG_COALESCE, HXAL_CONFIG_DELAY, HXAL_CONFIG_LATENCY}},
};
// clang-format on

void write_vports(std::FILE* file, const hxal_config_t& model, int idx)
{
    if (!has(model.iocs[idx].flags, HXAL_CONFIG_VPORT))
        return;
    for (const hxal_vf_config_t* port = model.iocs[idx].vport; port; port = port->next)
    {
        std::fprintf(file, "hxa%d-vport-%d = \"", idx, port->vidx);
        write_text(file, port->pwwn, sizeof port->pwwn);
        std::fputc(',', file);
        write_text(file, port->nwwn, sizeof port->nwwn);
        std::fputc(',', file);
        write_text(file, port->name, sizeof port->name);
        std::fputc(',', file);
        write_text(file, port->role, sizeof port->role);
        std::fprintf(file, ",%d\";\n", port->vf_id);
    }
}

// A value that no entry shows, as it was read; a text that is none of the setting's words as it is.
void write_as_read(std::FILE* file, const Setting& setting, const hxal_config_for_all_t& given)
{
    Ioc_Entry scratch{};
    if (setting.form.store(scratch, given.text))
        return setting.form.write(file, setting.key, scratch);
    std::fprintf(file, "%s = \"", setting.key);
    write_text(file, given.text, sizeof given.text);
    std::fputs("\";\n", file);
}

void write_for_all(std::FILE* file, const hxal_config_t& model, int code)
{
    const Setting* setting = setting_of(code);
    if (!setting || !is_for_all(model, code))
        return;
    const bool reached = has_reached(model, code);
    if (reached && setting->for_all == For_All::read)
        return;
    if (reached && has(model.iocs[0].flags, code))
        setting->form.write(file, setting->key, model.iocs[0]);
    else
        write_as_read(file, *setting, model.for_all[code]);
}

void write_setting(std::FILE* file, const hxal_config_t& model, const Setting& setting)
{
    // Lines of instances beside a value that reached none of them are their own.
    if (is_for_all(model, setting.code) && has_reached(model, setting.code) && setting.for_all == For_All::written)
        return;
    for (int idx = 0; idx < HXAL_CONFIG_ENTRIES; ++idx)
    {
        if (!has(model.iocs[idx].flags, setting.code))
            continue;
        char key[64];
        std::snprintf(key, sizeof key, "%s%d-%s", setting.prefix, idx, setting.key);
        setting.form.write(file, key, model.iocs[idx]);
    }
}

void write_instances(std::FILE* file, const hxal_config_t& model, int code)
{
    if (const Setting* setting = setting_of(code))
        return write_setting(file, model, *setting);
    for (int idx = 0; idx < HXAL_CONFIG_ENTRIES; ++idx)
        write_vports(file, model, idx);
}

void write_section(std::FILE* file, const hxal_config_t& model, const Section& section)
{
    std::fputs(section.heading, file);
    for (const hxal_config_code_t* code = section.codes; code != std::end(section.codes) && *code; ++code)
        write_for_all(file, model, *code);
    for (const hxal_config_code_t* code = section.codes; code != std::end(section.codes) && *code; ++code)
        write_instances(file, model, *code);
}

void write_serial(std::FILE* file, const hxal_ad_config_t& entry)
{
    std::fputs("adapter-", file);
    write_text(file, entry.id, sizeof entry.id);
}

void write_names(std::FILE* file, const hxal_config_t& model)
{
    for (const hxal_ad_config_t& entry : model.adapters)
    {
        if (!has(entry.flags, HXAL_CONFIG_AD_NAME))
            continue;
        write_serial(file, entry);
        std::fputs("-name = \"", file);
        write_text(file, entry.name, sizeof entry.name);
        std::fputs("\";\n", file);
    }
}

void write_powers(std::FILE* file, const hxal_config_t& model)
{
    const bool for_all = is_for_all(model, HXAL_CONFIG_AD_POWER), reached = has_reached(model, HXAL_CONFIG_AD_POWER);
    if (for_all)
    {
        const hxal_ad_config_t& first = model.adapters[0];
        const int given = number(model.for_all[HXAL_CONFIG_AD_POWER].text);
        const bool is_shown = reached && has(first.flags, HXAL_CONFIG_AD_POWER);
        std::fprintf(file, "power = %u;\n", is_shown ? first.power : static_cast<unsigned>(given));
    }
    if (for_all && reached)
        return;
    for (const hxal_ad_config_t& entry : model.adapters)
    {
        if (!has(entry.flags, HXAL_CONFIG_AD_POWER))
            continue;
        write_serial(file, entry);
        std::fprintf(file, "-power = %u;\n", entry.power);
    }
}

} // namespace

void hxal_config_unload(void) {}

void hxal_config_ad_update(FILE* file)
{
    if (!file)
        return;
    const Locked_Model model;
    std::fputs("# Syntax for global parameter (applied to all HBA instances):\n"
               "#   param_name=param_value \n"
               "#   hxa<instance_number>-param_name=param_value \n"
               "# \n"
               "\n#\n# Persistent naming of adapter\n# \n",
               file);
    write_names(file, *model);
    std::fputs("\n#\n# Power save settings\n# 0 - power on, 1-2 power save, 3 - power off\n#\n", file);
    write_powers(file, *model);
    model->adapter_lines = 0;
}

void hxal_config_ioc_update(FILE* file)
{
    if (!file)
        return;
    const Locked_Model model;
    for (const Section& section : sections)
        write_section(file, *model, section);
}

void vport_traverse(FILE* file, int idx)
{
    if (!file || !is_entry(idx))
        return;
    const Locked_Model model;
    write_vports(file, *model, idx);
}
