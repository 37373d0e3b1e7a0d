#include "hxal/aen.h"

#include "hxal/internal/addresses.h"
#include "hxal/internal/aen_dispatch.h"
#include "hxal/internal/aen_registrations.h"
#include "hxal/internal/text.h"
#include "hxal/lport.h"

#include <cstdio>

namespace
{

// clang-format off
struct Adapter_Filter { char serial_num[12]; bool any_added; };
struct Port_Filter    { wwn_t pwwn; mac_t mac; };
struct Lport_Filter   { wwn_t lpwwn; };
struct Rport_Filter   { wwn_t lpwwn; };
struct Itnim_Filter   { wwn_t lpwwn; wwn_t rpwwn; };
struct Audit_Filter   { wwn_t pwwn; };
struct Ioc_Filter     { };
struct Ethport_Filter { mac_t mac; };
// clang-format on

} // namespace

// clang-format off
struct hxal_adapter_aen_cbhandle_s : hxal::Registration<hxal_adapter_aen_cbhandle_s, hxal_adapter_aen_cbfn_t, Adapter_Filter> {};
struct hxal_port_aen_cbhandle_s    : hxal::Registration<hxal_port_aen_cbhandle_s,    hxal_port_aen_cbfn_t,    Port_Filter>    {};
struct hxal_lport_aen_cbhandle_s   : hxal::Registration<hxal_lport_aen_cbhandle_s,   hxal_lport_aen_cbfn_t,   Lport_Filter>   {};
struct hxal_rport_aen_cbhandle_s   : hxal::Registration<hxal_rport_aen_cbhandle_s,   hxal_rport_aen_cbfn_t,   Rport_Filter>   {};
struct hxal_itnim_aen_cbhandle_s   : hxal::Registration<hxal_itnim_aen_cbhandle_s,   hxal_itnim_aen_cbfn_t,   Itnim_Filter>   {};
struct hxal_audit_aen_cbhandle_s   : hxal::Registration<hxal_audit_aen_cbhandle_s,   hxal_audit_aen_cbfn_t,   Audit_Filter>   {};
struct hxal_ioc_aen_cbhandle_s     : hxal::Registration<hxal_ioc_aen_cbhandle_s,     hxal_ioc_aen_cbfn_t,     Ioc_Filter>     {};
struct hxal_ethport_aen_cbhandle_s : hxal::Registration<hxal_ethport_aen_cbhandle_s, hxal_ethport_aen_cbfn_t, Ethport_Filter> {};
// clang-format on

namespace
{

constinit hxal::Registration_List<hxal_adapter_aen_cbhandle_s> adapters;
constinit hxal::Registration_List<hxal_port_aen_cbhandle_s> ports;
constinit hxal::Registration_List<hxal_lport_aen_cbhandle_s> lports;
constinit hxal::Registration_List<hxal_rport_aen_cbhandle_s> rports;
constinit hxal::Registration_List<hxal_itnim_aen_cbhandle_s> itnims;
constinit hxal::Registration_List<hxal_audit_aen_cbhandle_s> audits;
constinit hxal::Registration_List<hxal_ioc_aen_cbhandle_s> iocs;
constinit hxal::Registration_List<hxal_ethport_aen_cbhandle_s> ethports;

// Which events of an IOC a filter lets through.

bool matches(const Port_Filter& filter, uint32_t, const hxa_port_aen_data_t& data)
{
    return (data.pwwn != 0 && data.pwwn == filter.pwwn) || hxal::same_mac(data.mac, filter.mac);
}

bool matches(const Lport_Filter& filter, uint32_t event, const hxa_lport_aen_data_t& data)
{
    return event == HXA_LPORT_AEN_NEW ? filter.lpwwn == 0 : data.lpwwn == filter.lpwwn;
}

bool matches(const Rport_Filter& filter, uint32_t, const hxa_rport_aen_data_t& data) { return data.lpwwn == filter.lpwwn; }

bool matches(const Itnim_Filter& filter, uint32_t, const hxa_itnim_aen_data_t& data)
{
    return data.lpwwn == filter.lpwwn && (filter.rpwwn == 0 || data.rpwwn == filter.rpwwn);
}

bool matches(const Audit_Filter& filter, uint32_t, const hxa_audit_aen_data_t& data) { return data.pwwn == filter.pwwn; }

bool matches(const Ioc_Filter&, uint32_t, const hxa_ioc_aen_data_t&) { return true; }

bool matches(const Ethport_Filter& filter, uint32_t, const hxa_ethport_aen_data_t& data)
{
    return hxal::same_mac(data.mac, filter.mac);
}

template <typename Record, typename Data> bool is_for(const Record& record, const hxa_aen_entry_t& entry, const Data& data)
{
    return record.inst == static_cast<int16_t>(entry.hxad_num) && matches(record.filter, entry.aen_type, data);
}

// Adapter events come from whichever IOC is left to tell: the card counts, not the IOC.
bool is_for(const hxal_adapter_aen_cbhandle_s& record, const hxa_aen_entry_t& entry, const hxa_adapter_aen_data_t& data)
{
    if (record.filter.any_added)
        return entry.aen_type == HXA_ADAPTER_AEN_ADD;
    char serial[sizeof data.serial_num + 1];
    hxal::copy_text(serial, data.serial_num);
    return hxal::same_text(serial, record.filter.serial_num);
}

// How a registration is called, in the short form where it asked for it and there is one.

template <typename Record, typename Data>
hxa_status_t deliver(const Record& record, const hxa_aen_entry_t& entry, const Data& data)
{
    record.cbfn(record.userData, entry.aen_type, &data, entry.aen_tv);
    return HXA_STATUS_OK;
}

template <typename Short_Form, typename Record> Short_Form short_form(const Record& record)
{
    using Any_Form = void (*)();
    if ((record.flags & hxal::snia_form) == 0)
        return nullptr;
    return reinterpret_cast<Short_Form>(reinterpret_cast<Any_Form>(record.cbfn));
}

uint32_t snia_code(const hxa_aen_entry_t& entry) { return hxal_snia_event_convert(entry.aen_category, entry.aen_type); }

hxa_status_t deliver(const hxal_adapter_aen_cbhandle_s& record, const hxa_aen_entry_t& entry, const hxa_adapter_aen_data_t& data)
{
    const auto call = short_form<hxal_adapter_snia_cbfn_t>(record);
    if (!call)
        return deliver<>(record, entry, data);
    call(record.userData, data.pwwn, snia_code(entry));
    return HXA_STATUS_OK;
}

hxa_status_t deliver(const hxal_lport_aen_cbhandle_s& record, const hxa_aen_entry_t& entry, const hxa_lport_aen_data_t& data)
{
    const auto call = short_form<hxal_lport_snia_cbfn_t>(record);
    if (!call)
        return deliver<>(record, entry, data);
    const hxal_t* ioc = hxal_ioc_get_by_inst(static_cast<uint16_t>(entry.hxad_num));
    if (!ioc)
        return HXA_STATUS_FAILED;
    hxa_port_attr_t attributes;
    const bool known = hxal_lport_get_attr(ioc, 0, data.lpwwn, &attributes) == HXA_STATUS_OK;
    call(record.userData, data.lpwwn, snia_code(entry), known ? attributes.pid : 0);
    return HXA_STATUS_OK;
}

hxa_status_t deliver(const hxal_itnim_aen_cbhandle_s& record, const hxa_aen_entry_t& entry, const hxa_itnim_aen_data_t& data)
{
    const auto call = short_form<hxal_itnim_snia_cbfn_t>(record);
    if (!call)
        return deliver<>(record, entry, data);
    call(record.userData, data.lpwwn, data.rpwwn, snia_code(entry));
    return HXA_STATUS_OK;
}

template <typename List, typename Data> void dispatch(List& list, const hxa_aen_entry_t& entry, const Data& data)
{
    list.dispatch([&](const auto& record) { return is_for(record, entry, data); },
                  [&](const auto& record) { return deliver(record, entry, data); });
}

template <typename Record, typename Callback, typename Filter>
hxa_status_t enlist(hxal::Registration_List<Record>& list, const hxal_t* ioc, Callback cbfn, void* userData, const Filter& filter,
                    Record** cbhandle, uint32_t flag = 0)
{
    if (!cbfn || !cbhandle)
        return HXA_STATUS_EINVAL;
    return hxal::within_memory(
        [&]
        {
            auto record = std::make_unique<Record>();
            record->bind(ioc);
            record->userData = userData;
            record->cbfn = cbfn;
            record->filter = filter;
            record->flags = flag & hxal::snia_form;
            list.add(std::move(record), *cbhandle);
            return HXA_STATUS_OK;
        });
}

template <typename Record> hxa_status_t delist(hxal::Registration_List<Record>& list, const Record* cbhandle)
{
    return list.remove(cbhandle) ? HXA_STATUS_OK : HXA_STATUS_FAILED;
}

template <typename Record> hxa_status_t delist_or_tell(hxal::Registration_List<Record>& list, const Record* cbhandle)
{
    const hxa_status_t status = delist(list, cbhandle);
    if (status != HXA_STATUS_OK)
        std::printf("Event callback not registered for handle: %p\n", static_cast<const void*>(cbhandle));
    return status;
}

bool is_ethernet(const hxal_t* ioc) { return ioc && ioc->ioc_type == HXA_IOC_TYPE_LL; }

const hxal_t* first_ioc(const hxal_adapter_t* ad)
{
    if (!ad)
        return nullptr;
    return ad->fcioc_list ? ad->fcioc_list : ad->ethioc_list;
}

} // namespace

std::vector<int> hxal::hxal_aen_fd_collect()
{
    std::vector<int> descriptors;
    adapters.collect(descriptors);
    lports.collect(descriptors);
    itnims.collect(descriptors);
    ports.collect(descriptors);
    rports.collect(descriptors);
    audits.collect(descriptors);
    iocs.collect(descriptors);
    ethports.collect(descriptors);
    return descriptors;
}

void hxal::dispatch_event(const hxa_aen_entry_t& entry)
{
    switch (entry.aen_category)
    {
    case HXA_AEN_CAT_ADAPTER:
        return dispatch(adapters, entry, entry.aen_data.adapter);
    case HXA_AEN_CAT_PORT:
        return dispatch(ports, entry, entry.aen_data.port);
    case HXA_AEN_CAT_LPORT:
        return dispatch(lports, entry, entry.aen_data.lport);
    case HXA_AEN_CAT_RPORT:
        return dispatch(rports, entry, entry.aen_data.rport);
    case HXA_AEN_CAT_ITNIM:
        return dispatch(itnims, entry, entry.aen_data.itnim);
    case HXA_AEN_CAT_AUDIT:
        return dispatch(audits, entry, entry.aen_data.audit);
    case HXA_AEN_CAT_IOC:
        return dispatch(iocs, entry, entry.aen_data.ioc);
    case HXA_AEN_CAT_ETHPORT:
        return dispatch(ethports, entry, entry.aen_data.ethport);
    default:
        return;
    }
}

hxa_status_t hxal_adapter_aen_register(const hxal_adapter_t* ad, hxal_adapter_aen_cbfn_t cbfn, void* userData,
                                       hxal_adapter_aen_cbhandle_t** cbhandle, uint32_t flag)
{
    Adapter_Filter filter = {.serial_num = {}, .any_added = !ad};
    if (ad)
        hxal::copy_text(filter.serial_num, ad->serial_num);
    return enlist(adapters, first_ioc(ad), cbfn, userData, filter, cbhandle, flag);
}

hxa_status_t hxal_port_aen_register(const hxal_t* ioc, hxal_port_aen_cbfn_t cbfn, void* userData, const hxa_port_aen_data_t* data,
                                    hxal_port_aen_cbhandle_t** cbhandle)
{
    if (!data)
        return HXA_STATUS_EINVAL;
    const Port_Filter filter = is_ethernet(ioc) ? Port_Filter{0, data->mac} : Port_Filter{data->pwwn, {}};
    return enlist(ports, ioc, cbfn, userData, filter, cbhandle);
}

hxa_status_t hxal_lport_aen_register(const hxal_t* ioc, hxal_lport_aen_cbfn_t cbfn, void* userData,
                                     const hxa_lport_aen_data_t* data, hxal_lport_aen_cbhandle_t** cbhandle, uint32_t flag)
{
    if (!data)
        return HXA_STATUS_EINVAL;
    return enlist(lports, ioc, cbfn, userData, Lport_Filter{data->lpwwn}, cbhandle, flag);
}

hxa_status_t hxal_rport_aen_register(const hxal_t* ioc, hxal_rport_aen_cbfn_t cbfn, void* userData,
                                     const hxa_rport_aen_data_t* data, hxal_rport_aen_cbhandle_t** cbhandle)
{
    if (!data)
        return HXA_STATUS_EINVAL;
    return enlist(rports, ioc, cbfn, userData, Rport_Filter{data->lpwwn}, cbhandle);
}

hxa_status_t hxal_itnim_aen_register(const hxal_t* ioc, hxal_itnim_aen_cbfn_t cbfn, void* userData,
                                     const hxa_itnim_aen_data_t* data, hxal_itnim_aen_cbhandle_t** cbhandle, uint32_t flag)
{
    if (!data)
        return HXA_STATUS_EINVAL;
    return enlist(itnims, ioc, cbfn, userData, Itnim_Filter{data->lpwwn, data->rpwwn}, cbhandle, flag);
}

hxa_status_t hxal_audit_aen_register(const hxal_t* ioc, hxal_audit_aen_cbfn_t cbfn, void* userData,
                                     const hxa_audit_aen_data_t* data, hxal_audit_aen_cbhandle_t** cbhandle)
{
    if (!data)
        return HXA_STATUS_EINVAL;
    return enlist(audits, ioc, cbfn, userData, Audit_Filter{data->pwwn}, cbhandle);
}

hxa_status_t hxal_ioc_aen_register(const hxal_t* ioc, hxal_ioc_aen_cbfn_t cbfn, void* userData,
                                   hxal_ioc_aen_cbhandle_t** cbhandle)
{
    return enlist(iocs, ioc, cbfn, userData, Ioc_Filter{}, cbhandle);
}

hxa_status_t hxal_ethport_aen_register(const hxal_t* ioc, hxal_ethport_aen_cbfn_t cbfn, void* userData,
                                       const hxa_ethport_aen_data_t*, hxal_ethport_aen_cbhandle_t** cbhandle)
{
    return enlist(ethports, ioc, cbfn, userData, Ethport_Filter{hxal_ioc_get_mac(ioc)}, cbhandle);
}

// clang-format off
hxa_status_t hxal_adapter_aen_unregister(hxal_adapter_aen_cbhandle_t* cbhandle) { return delist(adapters, cbhandle); }
hxa_status_t hxal_port_aen_unregister(hxal_port_aen_cbhandle_t* cbhandle)       { return delist_or_tell(ports, cbhandle); }
hxa_status_t hxal_lport_aen_unregister(hxal_lport_aen_cbhandle_t* cbhandle)     { return delist(lports, cbhandle); }
hxa_status_t hxal_rport_aen_unregister(hxal_rport_aen_cbhandle_t* cbhandle)     { return delist_or_tell(rports, cbhandle); }
hxa_status_t hxal_itnim_aen_unregister(hxal_itnim_aen_cbhandle_t* cbhandle)     { return delist(itnims, cbhandle); }
hxa_status_t hxal_audit_aen_unregister(hxal_audit_aen_cbhandle_t* cbhandle)     { return delist_or_tell(audits, cbhandle); }
hxa_status_t hxal_ioc_aen_unregister(hxal_ioc_aen_cbhandle_t* cbhandle)         { return delist_or_tell(iocs, cbhandle); }
hxa_status_t hxal_ethport_aen_unregister(hxal_ethport_aen_cbhandle_t* cbhandle) { return delist_or_tell(ethports, cbhandle); }
// clang-format on
