#include "hxal/config/model.h"

#include "hxal/adapter.h"
#include "hxal/config/internal/settings.h"
#include "hxal/config/internal/state.h"
#include "hxal/config/internal/syntax.h"
#include "hxal/internal/addresses.h"
#include "hxal/internal/fixed_text.h"

namespace hxal::config
{

namespace
{

constinit std::mutex model_mutex;
constinit hxal_config_t the_model{};
constinit wwn_t pwwns[HXAL_CONFIG_ENTRIES]{};

// The index of the first entry that fits; none: -1.
template <typename Entry, typename Fits> int first_index(const Entry (&entries)[HXAL_CONFIG_ENTRIES], Fits fits)
{
    const auto found = std::find_if(std::begin(entries), std::end(entries), fits);
    return found == std::end(entries) ? -1 : static_cast<int>(found - std::begin(entries));
}

template <typename Entry> int first_without(const Entry (&entries)[HXAL_CONFIG_ENTRIES], int code)
{
    return first_index(entries, [=](const Entry& entry) { return !has(entry.flags, code); });
}

template <typename Entry> int count_with(const Entry (&entries)[HXAL_CONFIG_ENTRIES], int code)
{
    return static_cast<int>(
        std::count_if(std::begin(entries), std::end(entries), [=](const Entry& entry) { return has(entry.flags, code); }));
}

} // namespace

Locked_Model::Locked_Model() : lock(model_mutex) {}
hxal_config_t& Locked_Model::operator*() const { return the_model; }

int ad_lookup(const hxal_config_t& model, const char* serial)
{
    return first_index(model.adapters, [=](const hxal_ad_config_t& entry)
                       { return has(entry.flags, HXAL_CONFIG_AD_SERIAL) && same_serial(serial, entry.id); });
}

int ioc_lookup(const hxal_config_t& model, wwn_t pwwn)
{
    for (int idx = 0; idx < HXAL_CONFIG_ENTRIES; ++idx)
        if (pwwns[idx] == pwwn && has(model.iocs[idx].flags, HXAL_CONFIG_PORT_WWN))
            return idx;
    return -1;
}

int ethioc_lookup(const hxal_config_t& model, const mac_t& mac)
{
    char text[mac_text_size];
    write_mac(text, mac);
    return first_index(model.iocs,
                       [&](const Ioc_Entry& entry) {
                           return has(entry.flags, HXAL_CONFIG_PORT_MAC) && std::strncmp(text, entry.mac, mac_text_size - 1) == 0;
                       });
}

int ad_get_num(const hxal_config_t& model) { return count_with(model.adapters, HXAL_CONFIG_AD_SERIAL); }
int ioc_get_num(const hxal_config_t& model) { return count_with(model.iocs, HXAL_CONFIG_PORT_WWN); }

void pwwn_changed(const hxal_config_t& model, int idx) { pwwns[idx] = wwn_of(model.iocs[idx].pwwn); }

} // namespace hxal::config

using namespace hxal::config;

const hxal_config_t* hxal_config_get(void) { return &the_model; }

int hxal_config_ad_get_num(void) { return ad_get_num(*Locked_Model()); }
int hxal_config_ioc_get_num(void) { return ioc_get_num(*Locked_Model()); }

int hxal_config_ad_lookup(const char* serial) { return ad_lookup(*Locked_Model(), serial); }
int hxal_config_ioc_lookup(wwn_t pwwn) { return ioc_lookup(*Locked_Model(), pwwn); }
int hxal_config_ethioc_lookup(mac_t mac) { return ethioc_lookup(*Locked_Model(), mac); }

void hxal_config_ad_add(const char* serial)
{
    const Locked_Model model;
    if (serial && *serial)
        store(*model, HXAL_CONFIG_AD_SERIAL, first_without(model->adapters, HXAL_CONFIG_AD_SERIAL), serial);
}

void hxal_config_ioc_add(wwn_t pwwn)
{
    char text[wwn_text_size];
    write_wwn(text, pwwn);
    const Locked_Model model;
    store(*model, HXAL_CONFIG_PORT_WWN, first_without(model->iocs, HXAL_CONFIG_PORT_WWN), text);
}

void hxal_config_ethioc_add(mac_t mac)
{
    char text[mac_text_size];
    write_mac(text, mac);
    const Locked_Model model;
    store(*model, HXAL_CONFIG_PORT_MAC, first_without(model->iocs, HXAL_CONFIG_PORT_MAC), text);
}

void hxal_config_ioc_pwwn(uint16_t inst, wwn_t pwwn)
{
    char text[wwn_text_size];
    write_wwn(text, pwwn);
    const Locked_Model model;
    store(*model, HXAL_CONFIG_PORT_WWN, inst, text);
}

hxa_boolean_t hxal_config_get_ad_name_exists(int idx, const char* name, const char* serial)
{
    const hxal_adapter_t* adapter = hxal_adapter_open_idx(idx);
    if (!adapter || !name || !*name || !serial || hxal::same_text(serial, adapter->serial_num))
        return HXA_FALSE;
    const Locked_Model model;
    const int entry = ad_lookup(*model, adapter->serial_num);
    return entry >= 0 && std::strcmp(model->adapters[entry].name, name) == 0 ? HXA_TRUE : HXA_FALSE;
}

hxa_boolean_t hxal_config_get_port_name_exists(int idx, const char* name, int port_num)
{
    const hxal_t* ioc = hxal_adapter_get_ioc(hxal_adapter_open_idx(idx), port_num);
    if (!ioc || !name || !*name)
        return HXA_FALSE;
    const Locked_Model model;
    const bool fc = hxal::is_fc(*ioc);
    const int entry = fc ? ioc_lookup(*model, ioc->pwwn) : ethioc_lookup(*model, ioc->mac);
    if (entry < 0)
        return HXA_FALSE;
    return std::strcmp(fc ? model->iocs[entry].name : model->iocs[entry].ethname, name) == 0 ? HXA_TRUE : HXA_FALSE;
}
