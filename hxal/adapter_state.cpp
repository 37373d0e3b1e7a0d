// What an adapter does with all its IOCs: states and power.
#include "hxal/adapter.h"
#include "hxal/config/setters.h"
#include "hxal/internal/ioc_state.h"

#include <initializer_list>

namespace
{

// Walks the IOCs in the order of the ports, the FC or FCoE one of a port first, until `work` answers false. False then.
template <typename Work> bool each_ioc(const hxal_adapter_t& adapter, Work work)
{
    for (int port = 0; port < adapter.port_count; ++port)
        for (const hxal_t* ioc : {hxal_adapter_get_fcioc(&adapter, port), hxal_adapter_get_ethioc(&adapter, port)})
            if (ioc && !work(*ioc))
                return false;
    return true;
}

hxa_boolean_t all_in_state(const hxal_adapter_t* adapter, hxa_ioc_state_t state)
{
    const auto is_there = [=](const hxal_t& ioc) { return hxal::is_in_state(ioc, state); };
    return adapter && each_ioc(*adapter, is_there) ? HXA_TRUE : HXA_FALSE;
}

} // namespace

hxa_boolean_t hxal_adapter_is_enabled(int ad) { return all_in_state(hxal_adapter_open_idx(ad), HXA_IOC_OPERATIONAL); }
hxa_boolean_t hxal_adapter_is_disabled(int ad) { return all_in_state(hxal_adapter_open_idx(ad), HXA_IOC_DISABLED); }

hxa_status_t hxal_adapter_enable(int ad)
{
    const hxal_adapter_t* adapter = hxal_adapter_open_idx(ad);
    if (!adapter)
        return HXA_STATUS_FAILED;
    if (hxal_adapter_is_enabled(ad))
        return HXA_STATUS_AD_IS_ENABLE;

    bool all_were_enabled = true;
    hxa_status_t failed = HXA_STATUS_OK;
    each_ioc(*adapter,
             [&](const hxal_t& ioc)
             {
                 const hxa_status_t status = hxal_ioc_enable(&ioc);
                 all_were_enabled = all_were_enabled && status == HXA_STATUS_IOC_ENABLED;
                 if (status != HXA_STATUS_OK && status != HXA_STATUS_IOC_ENABLED)
                     failed = status;
                 return true;
             });
    return all_were_enabled ? HXA_STATUS_AD_IS_ENABLE : failed;
}

hxa_status_t hxal_adapter_disable(int ad)
{
    const hxal_adapter_t* adapter = hxal_adapter_open_idx(ad);
    if (!adapter)
        return HXA_STATUS_FAILED;

    hxa_status_t failed = HXA_STATUS_OK;
    each_ioc(*adapter,
             [&](const hxal_t& ioc)
             {
                 if (const hxa_status_t status = hxal_ioc_disable(&ioc); status != HXA_STATUS_OK)
                     failed = status;
                 return true;
             });
    return failed;
}

// One IOC that accepts speaks for the card.
hxa_status_t hxal_adapter_set_power(const hxal_adapter_t* ad, hxa_pm_ds_t state)
{
    if (!ad)
        return HXA_STATUS_EINVAL;
    hxa_status_t status = HXA_STATUS_FAILED;
    each_ioc(*ad,
             [&](const hxal_t& ioc)
             {
                 status = hxal_ioc_set_power(&ioc, state);
                 return status != HXA_STATUS_OK;
             });
    if (status == HXA_STATUS_OK)
        hxal_config_ad_ps(hxal_config_ad_lookup(ad->serial_num), state);
    return status;
}
