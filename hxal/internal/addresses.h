// How the look-ups compare IOCs.
#pragma once

#include "hxal/ioc.h"

#include <cstring>

namespace hxal
{

inline bool is_fc(const hxal_s& ioc) { return ioc.ioc_type == HXA_IOC_TYPE_FC || ioc.ioc_type == HXA_IOC_TYPE_FCoE; }
inline bool same_mac(const mac_t& one, const mac_t& other) { return std::memcmp(one.mac, other.mac, sizeof one.mac) == 0; }

} // namespace hxal
