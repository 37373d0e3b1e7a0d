#include "hxal/config/setters.h"

#include "hxal/adapter.h"
#include "hxal/config/internal/settings.h"
#include "hxal/config/internal/syntax.h"
#include "hxal/config/internal/vports.h"
#include "hxal/internal/addresses.h"

#include <cstdio>
#include <cstring>
#include <type_traits>

namespace
{

using namespace hxal::config;
using Ioc = Ioc_Entry;

// A value that changes is no longer that of all instances.
template <typename Value>
void put(hxal_config_t& model, Presence& flags, int code, Value& field, std::type_identity_t<Value> value, bool present)
{
    spread_for_all(model, code);
    if (field != value)
        set(model.config_all, code, false);
    field = value;
    set(flags, code, present);
}

template <std::size_t Size> void put_text(hxal_config_t& model, Presence& flags, int code, char (&field)[Size], const char* value)
{
    char cut[Size];
    copy(cut, value);
    spread_for_all(model, code);
    if (std::strcmp(field, cut) != 0)
        set(model.config_all, code, false);
    copy(field, cut);
    set(flags, code, *cut != '\0');
}

// The IOC entry of a handle, locked, and what a setter does to it: nothing when there is none.
class Change
{
public:
    // Only an FC port has a WWN. An entry whose text is no WWN converts to 0 and is nobody's.
    explicit Change(const hxal_t* ioc) : entry(ioc && ioc->pwwn != 0 ? entry_at(ioc_lookup(*model, ioc->pwwn)) : nullptr) {}

    Ioc* operator->() const { return entry; }
    Ioc& operator*() const { return *entry; }
    explicit operator bool() const { return entry != nullptr; }

    template <auto Member, typename Value> void put(int code, Value value, bool present)
    {
        if (entry)
            ::put(*model, entry->flags, code, entry->*Member, value, present);
    }

    void put_secret(const char* text)
    {
        if (entry)
            put_text(*model, entry->flags, HXAL_CONFIG_AUTH_ENCRYPT, entry->authsstring, text);
    }

private:
    Ioc* entry_at(int idx) const { return idx < 0 ? nullptr : &model->iocs[idx]; }

    Locked_Model model;
    Ioc* entry;
};

hxa_boolean_t truth(hxa_boolean_t value) { return value != HXA_FALSE ? HXA_TRUE : HXA_FALSE; }

template <auto Member> void put_boolean(const hxal_t* ioc, int code, hxa_boolean_t value, hxa_boolean_t kept)
{
    Change(ioc).put<Member>(code, truth(value), truth(value) == kept);
}

uint32_t stored_speed(hxa_pport_speed_t speed)
{
    return speed == HXA_PPORT_SPEED_AUTO ? uint32_t{HXA_PPORT_SPEED_UNKNOWN} : static_cast<uint32_t>(speed);
}

constexpr uint16_t default_vf_id = 1;
constexpr uint16_t default_maxfrsize = 2112;
constexpr uint16_t default_delay = 1125;
constexpr uint16_t default_latency = 225;

} // namespace

void hxal_config_ad_name(int ad, const char* name)
{
    const hxal_adapter_t* adapter = hxal_adapter_open_idx(ad);
    if (!adapter || !name)
        return;
    const Locked_Model model;
    const int idx = ad_lookup(*model, adapter->serial_num);
    if (idx >= 0)
        put_text(*model, model->adapters[idx].flags, HXAL_CONFIG_AD_NAME, model->adapters[idx].name, name);
}

void hxal_config_ad_ps(int idx, hxa_pm_ds_t power)
{
    if (!is_entry(idx))
        return;
    const Locked_Model model;
    hxal_ad_config_t& entry = model->adapters[idx];
    put(*model, entry.flags, HXAL_CONFIG_AD_POWER, entry.power, static_cast<uint32_t>(power), power != HXA_PM_DS_D0);
}

void hxal_config_ioc_name(const hxal_t* ioc, const char* name)
{
    if (!ioc || !name)
        return;
    const bool fc = hxal::is_fc(*ioc);
    if (fc && ioc->pwwn == 0)
        return;
    const Locked_Model model;
    const int idx = fc ? ioc_lookup(*model, ioc->pwwn) : ethioc_lookup(*model, ioc->mac);
    if (idx < 0)
        return;
    Ioc& entry = model->iocs[idx];
    put_text(*model, entry.flags, fc ? HXAL_CONFIG_PORT_NAME : HXAL_CONFIG_ETH_NAME, fc ? entry.name : entry.ethname, name);
}

void hxal_config_topology(const hxal_t* ioc, hxa_pport_topology_t topology)
{
    Change(ioc).put<&Ioc::topology>(HXAL_CONFIG_PORT_TOPOLOGY, static_cast<uint32_t>(topology),
                                    topology != HXA_PPORT_TOPOLOGY_NONE);
}

void hxal_config_speed(const hxal_t* ioc, hxa_pport_speed_t speed)
{
    Change(ioc).put<&Ioc::speed>(HXAL_CONFIG_PORT_SPEED, stored_speed(speed), stored_speed(speed) != 0);
}

void hxal_config_alpa(const hxal_t* ioc, uint8_t alpa, hxa_boolean_t mode)
{
    Change(ioc).put<&Ioc::alpa>(HXAL_CONFIG_PORT_HARDALPA, alpa, mode != HXA_FALSE);
}

void hxal_config_maxfrsz(const hxal_t* ioc, uint16_t maxfrsize)
{
    Change(ioc).put<&Ioc::maxfrsz>(HXAL_CONFIG_PORT_MAXFRSIZE, maxfrsize, maxfrsize != default_maxfrsize);
}

void hxal_config_trunk(const hxal_t* ioc, uint32_t pp_bmap, hxa_boolean_t mode)
{
    Change(ioc).put<&Ioc::trunking>(HXAL_CONFIG_PORT_TRUNK, pp_bmap, mode != HXA_FALSE);
}

void hxal_config_enable(const hxal_t* ioc, hxa_boolean_t enable)
{
    put_boolean<&Ioc::enable>(ioc, HXAL_CONFIG_PORT_ENABLE, enable, HXA_FALSE);
}

void hxal_config_ipfc_enable(const hxal_t* ioc, hxa_boolean_t enable)
{
    put_boolean<&Ioc::ipfc_enable>(ioc, HXAL_CONFIG_IPFC_ENABLE, enable, HXA_FALSE);
}

void hxal_config_log_level(const hxal_t* ioc, int level) { Change(ioc).put<&Ioc::log>(HXAL_CONFIG_LOG_LEVEL, level, level != 0); }

void hxal_config_vf_mode(const hxal_t* ioc, uint16_t vf_id, hxa_boolean_t mode)
{
    Change change(ioc);
    change.put<&Ioc::vf_enable>(HXAL_CONFIG_VF_ENABLE, truth(mode), mode != HXA_FALSE);
    change.put<&Ioc::vf_default_id>(HXAL_CONFIG_VF_DEFAULT, vf_id, vf_id != default_vf_id);
}

void hxal_config_vf_list(const hxal_t* ioc, uint16_t vf_id, hxa_boolean_t mode)
{
    Change change(ioc);
    if (!change || vf_id >= 16)
        return;
    const auto bit = static_cast<uint16_t>(1u << vf_id);
    const auto list = static_cast<uint16_t>(mode != HXA_FALSE ? change->vf_list | bit : change->vf_list & ~bit);
    change.put<&Ioc::vf_list>(HXAL_CONFIG_VF_LIST, list, list != 0);
}

void hxal_config_fcpim(const hxal_t* ioc, uint16_t pathtov)
{
    Change(ioc).put<&Ioc::pathtov>(HXAL_CONFIG_PATHTOV, pathtov, pathtov != 0);
}

void hxal_config_qdepth(const hxal_t* ioc, uint16_t qdepth)
{
    Change(ioc).put<&Ioc::qdepth>(HXAL_CONFIG_QDEPTH, qdepth, qdepth != 0);
}

void hxal_config_pbind(const hxal_t* ioc, hxa_boolean_t binding)
{
    put_boolean<&Ioc::binding>(ioc, HXAL_CONFIG_PERSISTENT_BINDING, binding, HXA_TRUE);
}

void hxal_config_qos(const hxal_t* ioc, hxa_boolean_t qos) { put_boolean<&Ioc::qos>(ioc, HXAL_CONFIG_QOS, qos, HXA_TRUE); }

void hxal_config_ratelim(const hxal_t* ioc, hxa_boolean_t ratelim)
{
    put_boolean<&Ioc::ratelim>(ioc, HXAL_CONFIG_RATELIM, ratelim, HXA_TRUE);
}

void hxal_config_defspeed(const hxal_t* ioc, hxa_pport_speed_t speed)
{
    Change(ioc).put<&Ioc::defspeed>(HXAL_CONFIG_RATELIM_DEFSPEED, stored_speed(speed),
                                    stored_speed(speed) != HXA_PPORT_SPEED_1GBPS);
}

void hxal_config_auth_policy(const hxal_t* ioc, hxa_boolean_t on)
{
    put_boolean<&Ioc::authpolicy>(ioc, HXAL_CONFIG_AUTH_POLICY, on, HXA_TRUE);
}

void hxal_config_auth_algo(const hxal_t* ioc, hxa_auth_algo_t algo)
{
    Change(ioc).put<&Ioc::authalgo>(HXAL_CONFIG_AUTH_ALGO, static_cast<uint32_t>(algo), static_cast<uint32_t>(algo) != 0);
}

void hxal_config_auth_group(const hxal_t* ioc, hxa_auth_group_t group)
{
    Change(ioc).put<&Ioc::authgroup>(HXAL_CONFIG_AUTH_GROUP, static_cast<uint32_t>(group), group != HXA_AUTH_GROUP_DH768);
}

void hxal_config_auth_secretsource(const hxal_t* ioc, hxa_auth_secretsource_t source)
{
    Change(ioc).put<&Ioc::authssource>(HXAL_CONFIG_AUTH_SECRETSOURCE, static_cast<uint32_t>(source),
                                       source != HXA_AUTH_SECSRC_LOCAL);
}

void hxal_config_auth_secretstring(const hxal_t* ioc, const uint32_t* words, int n)
{
    char text[sizeof(Ioc::authsstring)] = {};
    std::size_t length = 0;
    for (int i = 0; words && i < n; ++i)
    {
        char word[16];
        const int size = std::snprintf(word, sizeof word, length ? ",%u" : "%u", words[i]);
        if (length + static_cast<std::size_t>(size) >= sizeof text)
            break;
        std::memcpy(text + length, word, static_cast<std::size_t>(size));
        length += static_cast<std::size_t>(size);
    }
    Change(ioc).put_secret(text);
}

void hxal_config_iocfc_intr(const hxal_t* ioc, hxa_boolean_t coalesce, uint16_t delay, uint16_t latency)
{
    Change change(ioc);
    if (!change)
        return;
    const bool on = coalesce != HXA_FALSE;
    const bool defaults = delay == default_delay && latency == default_latency;
    change.put<&Ioc::coalesce>(HXAL_CONFIG_COALESCE, truth(coalesce), !on);
    change.put<&Ioc::delay>(HXAL_CONFIG_DELAY, on ? delay : change->delay, !(defaults || (!on && delay == 0)));
    change.put<&Ioc::latency>(HXAL_CONFIG_LATENCY, on ? latency : change->latency, !(defaults || (!on && latency == 0)));
}

void hxal_config_vport_add(const hxal_t* ioc, uint16_t vf_id, const hxa_port_cfg_t* port)
{
    if (!port)
        return;
    char wwn[wwn_text_size];
    hxal_vf_config_t added{};
    write_wwn(wwn, port->pwwn);
    copy(added.pwwn, wwn);
    write_wwn(wwn, port->nwwn);
    copy(added.nwwn, wwn);
    std::snprintf(added.role, sizeof added.role, "%u", port->roles);
    copy(added.name, std::string_view(port->sym_name, ::strnlen(port->sym_name, sizeof port->sym_name)));
    added.vf_id = vf_id;
    const Change change(ioc);
    if (change)
        put_vport(*change, added, {});
}

void hxal_config_vport_del(const hxal_t* ioc, wwn_t vpwwn)
{
    const Change change(ioc);
    if (change)
        drop_vport(*change, vpwwn);
}
