// The name of an adapter, which each of its two drivers keeps for itself.
#include "hxal/adapter.h"
#include "hxal/config/setters.h"
#include "hxal/internal/addresses.h"
#include "hxal/internal/fixed_text.h"
#include "hxal/internal/request.h"
#include "hxal/library.h"

namespace
{

hxal_adapter_t* adapter_at(unsigned ad)
{
    return ad <= hxal_adapter_get_num() ? hxal_adapter_open_idx(static_cast<int>(ad)) : nullptr;
}

// HXA_STATUS_FAILED for a request that fails, whatever errno says.
hxa_status_t send_name(const hxal_t& ioc, const char* name)
{
    auto record = hxal::request_for<hxa_ioctl_ioc_set_adapter_name_t>(ioc);
    hxal::put_text(record.name, name);
    const hxa_status_t sent = hxal::send(ioc, "IOCMD_IOC_SET_ADAPTER_NAME", record);
    return sent == HXA_STATUS_OK ? record.status : HXA_STATUS_FAILED;
}

// Tells the driver of the first IOC, then the other driver.
hxa_status_t send_to_both_drivers(const hxal_adapter_t& adapter, const hxal_t& first, const char* name)
{
    if (const hxa_status_t failed = send_name(first, name); failed != HXA_STATUS_OK)
        return failed;
    const hxal_t* other = hxal::is_fc(first) ? hxal_adapter_get_ethioc(&adapter, 0) : hxal_adapter_get_fcioc(&adapter, 0);
    return other ? send_name(*other, name) : HXA_STATUS_OK;
}

hxa_status_t set_name(unsigned ad, const char* name)
{
    hxal_adapter_t* adapter = adapter_at(ad);
    const hxal_t* first = hxal_adapter_get_first_ioc(adapter);
    if (!first)
        return HXA_STATUS_NO_ADAPTER;
    if (!name)
        return HXA_STATUS_EINVAL;
    if (const hxa_status_t failed = send_to_both_drivers(*adapter, *first, name); failed != HXA_STATUS_OK)
        return failed;
    hxal_config_ad_name(adapter->id, name);
    hxal::keep_text(adapter->name, name);
    return HXA_STATUS_OK;
}

} // namespace

const char* hxal_adapter_get_name(unsigned ad)
{
    hxal_adapter_t* adapter = adapter_at(ad);
    const hxal_t* ioc = hxal_adapter_get_first_ioc(adapter);
    if (!ioc)
        return nullptr;
    hxa_ioctl_ioc_info_t info;
    if (hxal_ioc_get_info(ioc, &info) == HXA_STATUS_OK)
        hxal::copy_text(adapter->name, info.name);
    return adapter->name;
}

void hxal_adapter_set_name(unsigned ad, const char* name) { hxal_set_last_error(set_name(ad, name)); }
