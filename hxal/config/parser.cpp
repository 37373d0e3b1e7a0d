#include "hxal/config/parser.h"

#include "hxal/config/internal/settings.h"
#include "hxal/config/internal/syntax.h"
#include "hxal/config/internal/vports.h"

namespace
{

using namespace hxal::config;

struct Tuning
{
    std::string_view key;
    int hxal_config_tuning_t::*value;
};

using T = hxal_config_tuning_t;

// clang-format off
constexpr Tuning tunings[] = {
    {"msix-disable",         &T::msix_disable},
    {"num-rports",           &T::num_rports},
    {"num-ios",              &T::num_ios},
    {"num-tms",              &T::num_tms},
    {"num-fcxps",            &T::num_fcxps},
    {"num-ufbufs",           &T::num_ufbufs},
    {"reqq-size",            &T::reqq_size},
    {"rspq-size",            &T::rspq_size},
    {"num-sgpgs",            &T::num_sgpgs},
    {"ioc-auto-recover",     &T::ioc_auto_recover},
    {"ipfc-disable",         &T::ipfc_disable},
    {"rport-del-timeout",    &T::rport_del_timeout},
    {"dma-relaxed-ordering", &T::dma_relaxed_ordering},
    {"pcie-max-read-reqsz",  &T::pcie_max_read_reqsz},
};
// clang-format on

bool contains(std::string_view text, std::string_view part) { return text.find(part) != text.npos; }

// A key and its value, both filtered. No key, no value: empty.
struct Assignment
{
    std::string_view key;
    std::string_view value;
};

Assignment assignment(char start, std::string_view line)
{
    const auto key = raw_key(start, '=', line);
    const auto value = raw_data('=', line);
    return key && value ? Assignment{filtered(*key), filtered(*value)} : Assignment{};
}

void parse_adapter(hxal_config_t& model, std::string_view line)
{
    const auto serial = raw_key('-', '-', line);
    if (!serial || !is_entry(model.adapter_lines))
        return;
    const int idx = model.adapter_lines++;
    store(model, HXAL_CONFIG_AD_SERIAL, idx, filtered(*serial));
    const auto [key, value] = assignment('-', line);
    if (contains(key, "name"))
        store(model, HXAL_CONFIG_AD_NAME, idx, value);
    if (contains(key, "power"))
        store(model, HXAL_CONFIG_AD_POWER, idx, value);
}

void parse_instance(hxal_config_t& model, std::string_view prefix, std::string_view line)
{
    const int idx = number(line.substr(0, line.find('-'))); // not filtered: "hxa1 -" ends in no number
    if (!is_entry(idx))
        return;
    const auto [key, value] = assignment('-', line);
    if (const Setting* setting = setting_with(prefix, key))
        store(model, *setting, idx, value);
    else if (prefix == "hxa" && contains(key, "vport"))
        store_vport(model.iocs[idx], value, has_number(key) ? std::optional(number(key)) : std::nullopt);
}

void parse_for_all(hxal_config_t& model, std::string_view line)
{
    const auto [key, value] = assignment('\0', line);
    for (const Tuning& tuning : tunings)
        if (tuning.key == key)
            model.tuning.*tuning.value = number(value);
    if (key == "power")
        store_for_all(model, HXAL_CONFIG_AD_POWER, value);
    if (const Setting* setting = setting_for_all(key))
        store_for_all(model, setting->code, value);
}

} // namespace

void hxal_config_parse(const char* line)
{
    const std::string_view text = view_of(line);
    const Locked_Model model;
    const bool dashed = contains(text, "-");
    if (dashed && contains(text, "adapter"))
        parse_adapter(*model, text);
    else if (dashed && contains(text, "hxa"))
        parse_instance(*model, "hxa", text);
    else if (dashed && contains(text, "hxn"))
        parse_instance(*model, "hxn", text);
    else
        parse_for_all(*model, text);
}

void hxal_config_set_data(int code, int idx, const void* value)
{
    const Locked_Model model;
    if (value)
        store(*model, code, idx, static_cast<const char*>(value));
}
