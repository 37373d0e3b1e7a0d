#include "hxal/aen.h"

#include "hxal/internal/adapter_list.h"
#include "hxal/internal/aen_dispatch.h"
#include "hxal/internal/fixed_text.h"
#include "hxal/internal/ioc_state.h"
#include "hxal/internal/memory.h"

#include <cstdio>

namespace
{

using hxal::Filter;
using hxal::Kind;

// A share of an open descriptor that a handle of the library uses; null when none does.
std::shared_ptr<hxal::Descriptor> listed_descriptor(int fd)
{
    if (auto found = hxal::descriptor_of(fd))
        return found;
    const auto has_it = [=](const hxal_s& ioc) { return ioc.fd == fd; };
    for (hxal_adapter_t* adapter = hxal::adapter_list(); adapter; adapter = adapter->next)
        for (hxal_s* head : {adapter->fcioc_list, adapter->ethioc_list})
            if (hxal_s* ioc = hxal::first_that(head, has_it))
                return static_cast<hxal::Ioc_Node*>(ioc)->node;
    return nullptr;
}

template <typename Callback, typename Handle>
hxa_status_t enlist(hxa_aen_category_t category, const hxal_t* ioc, Callback cbfn, void* userData, const Filter& filter,
                    Handle** cbhandle, uint32_t flag = 0)
{
    if (!cbfn || !cbhandle)
        return HXA_STATUS_EINVAL;
    return hxal::within_memory(
        [&]
        {
            auto registration = std::make_unique<hxal::Registration>();
            if (ioc)
            {
                registration->fd = ioc->fd;
                registration->inst = static_cast<int16_t>(ioc->instance);
                registration->node = listed_descriptor(ioc->fd);
            }
            registration->userData = userData;
            registration->callback = reinterpret_cast<hxal::Any_Callback>(cbfn);
            registration->filter = filter;
            registration->flags = flag & hxal::snia_form;
            hxal::kind_of(category)->registrations.add(std::move(registration), *cbhandle);
            return HXA_STATUS_OK;
        });
}

hxa_status_t delist(hxa_aen_category_t category, const void* cbhandle)
{
    Kind& kind = *hxal::kind_of(category);
    if (kind.registrations.remove(cbhandle))
        return HXA_STATUS_OK;
    if (kind.tells_unknown_handles)
        std::printf("Event callback not registered for handle: %p\n", cbhandle);
    return HXA_STATUS_FAILED;
}

const hxal_t* first_ioc(const hxal_adapter_t* ad)
{
    if (!ad)
        return nullptr;
    return ad->fcioc_list ? ad->fcioc_list : ad->ethioc_list;
}

} // namespace

hxa_status_t hxal_adapter_aen_register(const hxal_adapter_t* ad, hxal_adapter_aen_cbfn_t cbfn, void* userData,
                                       hxal_adapter_aen_cbhandle_t** cbhandle, uint32_t flag)
{
    Filter filter{.any_added = !ad};
    if (ad)
        hxal::copy_text(filter.serial_num, ad->serial_num);
    return enlist(HXA_AEN_CAT_ADAPTER, first_ioc(ad), cbfn, userData, filter, cbhandle, flag);
}

hxa_status_t hxal_port_aen_register(const hxal_t* ioc, hxal_port_aen_cbfn_t cbfn, void* userData, const hxa_port_aen_data_t* data,
                                    hxal_port_aen_cbhandle_t** cbhandle)
{
    if (!data)
        return HXA_STATUS_EINVAL;
    const Filter filter = hxal::is_ethernet(ioc) ? Filter{.mac = data->mac} : Filter{.wwn = data->pwwn};
    return enlist(HXA_AEN_CAT_PORT, ioc, cbfn, userData, filter, cbhandle);
}

hxa_status_t hxal_lport_aen_register(const hxal_t* ioc, hxal_lport_aen_cbfn_t cbfn, void* userData,
                                     const hxa_lport_aen_data_t* data, hxal_lport_aen_cbhandle_t** cbhandle, uint32_t flag)
{
    if (!data)
        return HXA_STATUS_EINVAL;
    return enlist(HXA_AEN_CAT_LPORT, ioc, cbfn, userData, {.wwn = data->lpwwn}, cbhandle, flag);
}

hxa_status_t hxal_rport_aen_register(const hxal_t* ioc, hxal_rport_aen_cbfn_t cbfn, void* userData,
                                     const hxa_rport_aen_data_t* data, hxal_rport_aen_cbhandle_t** cbhandle)
{
    if (!data)
        return HXA_STATUS_EINVAL;
    return enlist(HXA_AEN_CAT_RPORT, ioc, cbfn, userData, {.wwn = data->lpwwn}, cbhandle);
}

hxa_status_t hxal_itnim_aen_register(const hxal_t* ioc, hxal_itnim_aen_cbfn_t cbfn, void* userData,
                                     const hxa_itnim_aen_data_t* data, hxal_itnim_aen_cbhandle_t** cbhandle, uint32_t flag)
{
    if (!data)
        return HXA_STATUS_EINVAL;
    return enlist(HXA_AEN_CAT_ITNIM, ioc, cbfn, userData, {.wwn = data->lpwwn, .rpwwn = data->rpwwn}, cbhandle, flag);
}

hxa_status_t hxal_audit_aen_register(const hxal_t* ioc, hxal_audit_aen_cbfn_t cbfn, void* userData,
                                     const hxa_audit_aen_data_t* data, hxal_audit_aen_cbhandle_t** cbhandle)
{
    if (!data)
        return HXA_STATUS_EINVAL;
    return enlist(HXA_AEN_CAT_AUDIT, ioc, cbfn, userData, {.wwn = data->pwwn}, cbhandle);
}

hxa_status_t hxal_ioc_aen_register(const hxal_t* ioc, hxal_ioc_aen_cbfn_t cbfn, void* userData,
                                   hxal_ioc_aen_cbhandle_t** cbhandle)
{
    return enlist(HXA_AEN_CAT_IOC, ioc, cbfn, userData, {}, cbhandle);
}

hxa_status_t hxal_ethport_aen_register(const hxal_t* ioc, hxal_ethport_aen_cbfn_t cbfn, void* userData,
                                       const hxa_ethport_aen_data_t*, hxal_ethport_aen_cbhandle_t** cbhandle)
{
    return enlist(HXA_AEN_CAT_ETHPORT, ioc, cbfn, userData, {.mac = hxal_ioc_get_mac(ioc)}, cbhandle);
}

// clang-format off
hxa_status_t hxal_adapter_aen_unregister(hxal_adapter_aen_cbhandle_t* cbhandle) { return delist(HXA_AEN_CAT_ADAPTER, cbhandle); }
hxa_status_t hxal_port_aen_unregister(hxal_port_aen_cbhandle_t* cbhandle)       { return delist(HXA_AEN_CAT_PORT, cbhandle); }
hxa_status_t hxal_lport_aen_unregister(hxal_lport_aen_cbhandle_t* cbhandle)     { return delist(HXA_AEN_CAT_LPORT, cbhandle); }
hxa_status_t hxal_rport_aen_unregister(hxal_rport_aen_cbhandle_t* cbhandle)     { return delist(HXA_AEN_CAT_RPORT, cbhandle); }
hxa_status_t hxal_itnim_aen_unregister(hxal_itnim_aen_cbhandle_t* cbhandle)     { return delist(HXA_AEN_CAT_ITNIM, cbhandle); }
hxa_status_t hxal_audit_aen_unregister(hxal_audit_aen_cbhandle_t* cbhandle)     { return delist(HXA_AEN_CAT_AUDIT, cbhandle); }
hxa_status_t hxal_ioc_aen_unregister(hxal_ioc_aen_cbhandle_t* cbhandle)         { return delist(HXA_AEN_CAT_IOC, cbhandle); }
hxa_status_t hxal_ethport_aen_unregister(hxal_ethport_aen_cbhandle_t* cbhandle) { return delist(HXA_AEN_CAT_ETHPORT, cbhandle); }
// clang-format on
