// The one model of the process and its lock.
#pragma once

#include "hxal/config/model.h"

#include <mutex>

namespace hxal::config
{

using Ioc_Entry = hxal_ioc_config_t;
using Presence = uint32_t[4];

inline bool has(const Presence& flags, int code) { return (flags[code / 32] >> (code % 32) & 1) != 0; }

inline void set(Presence& flags, int code, bool present)
{
    const uint32_t bit = uint32_t{1} << (code % 32);
    flags[code / 32] = present ? flags[code / 32] | bit : flags[code / 32] & ~bit;
}

// Whether a setting was given without instance, and whether that reached any entry.
inline bool is_for_all(const hxal_config_t& model, int code) { return has(model.config_all, code); }
inline bool has_reached(const hxal_config_t& model, int code) { return model.for_all[code].reached > 0; }

inline bool is_entry(int idx) { return idx >= 0 && idx < HXAL_CONFIG_ENTRIES; }

// The model, locked for as long as this lives. One thread must not hold two.
class Locked_Model
{
public:
    Locked_Model();

    hxal_config_t& operator*() const;
    hxal_config_t* operator->() const { return &**this; }

private:
    std::lock_guard<std::mutex> lock;
};

// What the public functions of the same names do, for a caller that holds the lock.
int ad_lookup(const hxal_config_t& model, const char* serial);
int ioc_lookup(const hxal_config_t& model, wwn_t pwwn);
int ethioc_lookup(const hxal_config_t& model, const mac_t& mac);
int ad_get_num(const hxal_config_t& model);
int ioc_get_num(const hxal_config_t& model);

// The look-ups compare numbers: the WWN of an entry is converted once, here, after its text has changed.
void pwwn_changed(const hxal_config_t& model, int idx);

} // namespace hxal::config
