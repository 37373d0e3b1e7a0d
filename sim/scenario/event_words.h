// The words that a person may write for the events of the drivers.
#pragma once

#include "sim/scenario/json.h"

#include "hxal/records/aen.h"

#include <array>
#include <span>

namespace hxasim
{

// clang-format off
inline constexpr std::array event_category_words{
    Choice{"adapter", HXA_AEN_CAT_ADAPTER},
    Choice{"port",    HXA_AEN_CAT_PORT},
    Choice{"lport",   HXA_AEN_CAT_LPORT},
    Choice{"rport",   HXA_AEN_CAT_RPORT},
    Choice{"itnim",   HXA_AEN_CAT_ITNIM},
    Choice{"tin",     HXA_AEN_CAT_TIN},
    Choice{"ipfc",    HXA_AEN_CAT_IPFC},
    Choice{"audit",   HXA_AEN_CAT_AUDIT},
    Choice{"ioc",     HXA_AEN_CAT_IOC},
    Choice{"ethport", HXA_AEN_CAT_ETHPORT},
};

inline constexpr std::array adapter_event_words{
    Choice{"add",    HXA_ADAPTER_AEN_ADD},
    Choice{"remove", HXA_ADAPTER_AEN_REMOVE},
};

inline constexpr std::array port_event_words{
    Choice{"online",             HXA_PORT_AEN_ONLINE},
    Choice{"offline",            HXA_PORT_AEN_OFFLINE},
    Choice{"rlir",               HXA_PORT_AEN_RLIR},
    Choice{"sfp-insert",         HXA_PORT_AEN_SFP_INSERT},
    Choice{"sfp-remove",         HXA_PORT_AEN_SFP_REMOVE},
    Choice{"sfp-pom",            HXA_PORT_AEN_SFP_POM},
    Choice{"enable",             HXA_PORT_AEN_ENABLE},
    Choice{"disable",            HXA_PORT_AEN_DISABLE},
    Choice{"auth-on",            HXA_PORT_AEN_AUTH_ON},
    Choice{"auth-off",           HXA_PORT_AEN_AUTH_OFF},
    Choice{"disconnect",         HXA_PORT_AEN_DISCONNECT},
    Choice{"qos-neg",            HXA_PORT_AEN_QOS_NEG},
    Choice{"fabric-name-change", HXA_PORT_AEN_FABRIC_NAME_CHANGE},
    Choice{"sfp-access-error",   HXA_PORT_AEN_SFP_ACCESS_ERROR},
    Choice{"sfp-unsupport",      HXA_PORT_AEN_SFP_UNSUPPORT},
};

inline constexpr std::array lport_event_words{
    Choice{"new",             HXA_LPORT_AEN_NEW},
    Choice{"delete",          HXA_LPORT_AEN_DELETE},
    Choice{"online",          HXA_LPORT_AEN_ONLINE},
    Choice{"offline",         HXA_LPORT_AEN_OFFLINE},
    Choice{"disconnect",      HXA_LPORT_AEN_DISCONNECT},
    Choice{"new-prop",        HXA_LPORT_AEN_NEW_PROP},
    Choice{"delete-prop",     HXA_LPORT_AEN_DELETE_PROP},
    Choice{"new-standard",    HXA_LPORT_AEN_NEW_STANDARD},
    Choice{"delete-standard", HXA_LPORT_AEN_DELETE_STANDARD},
    Choice{"npiv-dup-wwn",    HXA_LPORT_AEN_NPIV_DUP_WWN},
    Choice{"npiv-fabric-max", HXA_LPORT_AEN_NPIV_FABRIC_MAX},
    Choice{"npiv-unknown",    HXA_LPORT_AEN_NPIV_UNKNOWN},
};

inline constexpr std::array rport_event_words{
    Choice{"online",     HXA_RPORT_AEN_ONLINE},
    Choice{"offline",    HXA_RPORT_AEN_OFFLINE},
    Choice{"disconnect", HXA_RPORT_AEN_DISCONNECT},
    Choice{"qos-prio",   HXA_RPORT_AEN_QOS_PRIO},
    Choice{"qos-flowid", HXA_RPORT_AEN_QOS_FLOWID},
};

inline constexpr std::array itnim_event_words{
    Choice{"online",     HXA_ITNIM_AEN_ONLINE},
    Choice{"offline",    HXA_ITNIM_AEN_OFFLINE},
    Choice{"disconnect", HXA_ITNIM_AEN_DISCONNECT},
};

inline constexpr std::array audit_event_words{
    Choice{"auth-enable",  HXA_AUDIT_AEN_AUTH_ENABLE},
    Choice{"auth-disable", HXA_AUDIT_AEN_AUTH_DISABLE},
};

inline constexpr std::array ioc_event_words{
    Choice{"hbgood",         HXA_IOC_AEN_HBGOOD},
    Choice{"hbfail",         HXA_IOC_AEN_HBFAIL},
    Choice{"enable",         HXA_IOC_AEN_ENABLE},
    Choice{"disable",        HXA_IOC_AEN_DISABLE},
    Choice{"fwmismatch",     HXA_IOC_AEN_FWMISMATCH},
    Choice{"fwcfg-error",    HXA_IOC_AEN_FWCFG_ERROR},
    Choice{"invalid-vendor", HXA_IOC_AEN_INVALID_VENDOR},
};

inline constexpr std::array ethport_event_words{
    Choice{"linkup",   HXA_ETHPORT_AEN_LINKUP},
    Choice{"linkdown", HXA_ETHPORT_AEN_LINKDOWN},
    Choice{"enable",   HXA_ETHPORT_AEN_ENABLE},
    Choice{"disable",  HXA_ETHPORT_AEN_DISABLE},
};
// clang-format on

// The words for the events of one category; none where its events have no names.
constexpr std::span<const Choice> event_words(std::uint32_t category)
{
    switch (category)
    {
    case HXA_AEN_CAT_ADAPTER:
        return adapter_event_words;
    case HXA_AEN_CAT_PORT:
        return port_event_words;
    case HXA_AEN_CAT_LPORT:
        return lport_event_words;
    case HXA_AEN_CAT_RPORT:
        return rport_event_words;
    case HXA_AEN_CAT_ITNIM:
        return itnim_event_words;
    case HXA_AEN_CAT_AUDIT:
        return audit_event_words;
    case HXA_AEN_CAT_IOC:
        return ioc_event_words;
    case HXA_AEN_CAT_ETHPORT:
        return ethport_event_words;
    default:
        return {};
    }
}

} // namespace hxasim
