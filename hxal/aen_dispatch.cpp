#include "hxal/internal/aen_dispatch.h"

#include "hxal/aen.h"
#include "hxal/internal/addresses.h"
#include "hxal/internal/fixed_text.h"
#include "hxal/lport.h"

#include <algorithm>
#include <iterator>

namespace
{

using Event = hxa_aen_entry_t;
using hxal::Registration;

// Which events a registration is for.

// Adapter events come from whichever IOC is left to tell: the card counts, not the IOC.
bool is_for_adapter(const Registration& registration, const Event& event)
{
    if (registration.filter.any_added)
        return event.aen_type == HXA_ADAPTER_AEN_ADD;
    return hxal::same_serial(registration.filter.serial_num, event.aen_data.adapter.serial_num);
}

bool is_for_ioc(const Registration& registration, const Event& event)
{
    return registration.inst == static_cast<int16_t>(event.hxad_num);
}

bool is_for_port(const Registration& registration, const Event& event)
{
    const hxa_port_aen_data_t& data = event.aen_data.port;
    const bool same_port =
        (data.pwwn != 0 && data.pwwn == registration.filter.wwn) || hxal::same_mac(data.mac, registration.filter.mac);
    return is_for_ioc(registration, event) && same_port;
}

bool is_for_lport(const Registration& registration, const Event& event)
{
    const bool is_new = event.aen_type == HXA_LPORT_AEN_NEW;
    return is_for_ioc(registration, event) && registration.filter.wwn == (is_new ? 0 : event.aen_data.lport.lpwwn);
}

bool is_for_rport(const Registration& registration, const Event& event)
{
    return is_for_ioc(registration, event) && registration.filter.wwn == event.aen_data.rport.lpwwn;
}

bool is_for_itnim(const Registration& registration, const Event& event)
{
    const hxa_itnim_aen_data_t& data = event.aen_data.itnim;
    const bool same_target = registration.filter.rpwwn == 0 || registration.filter.rpwwn == data.rpwwn;
    return is_for_ioc(registration, event) && registration.filter.wwn == data.lpwwn && same_target;
}

bool is_for_audit(const Registration& registration, const Event& event)
{
    return is_for_ioc(registration, event) && registration.filter.wwn == event.aen_data.audit.pwwn;
}

bool is_for_ethport(const Registration& registration, const Event& event)
{
    return is_for_ioc(registration, event) && hxal::same_mac(event.aen_data.ethport.mac, registration.filter.mac);
}

// How a registration is called: in the short form where it asked for it and its kind has one, else with the event's data, which
// are this type.

template <typename Data> hxa_status_t call_full(const Registration& registration, const Event& event)
{
    using Full_Form = void (*)(void*, uint32_t, const Data*, hxa_timeval_t);
    const auto* data = reinterpret_cast<const Data*>(&event.aen_data);
    reinterpret_cast<Full_Form>(registration.callback)(registration.userData, event.aen_type, data, event.aen_tv);
    return HXA_STATUS_OK;
}

bool wants_short(const Registration& registration) { return (registration.flags & hxal::snia_form) != 0; }
uint32_t snia_code(const Event& event) { return hxal_snia_event_convert(event.aen_category, event.aen_type); }

hxa_status_t call_adapter(const Registration& registration, const Event& event)
{
    if (!wants_short(registration))
        return call_full<hxa_adapter_aen_data_t>(registration, event);
    const auto callback = reinterpret_cast<hxal_adapter_snia_cbfn_t>(registration.callback);
    callback(registration.userData, event.aen_data.adapter.pwwn, snia_code(event));
    return HXA_STATUS_OK;
}

hxa_status_t call_lport(const Registration& registration, const Event& event)
{
    if (!wants_short(registration))
        return call_full<hxa_lport_aen_data_t>(registration, event);
    const hxal_t* ioc = hxal_ioc_get_by_inst(static_cast<uint16_t>(event.hxad_num));
    if (!ioc)
        return HXA_STATUS_FAILED;
    const wwn_t lpwwn = event.aen_data.lport.lpwwn;
    hxa_port_attr_t attributes;
    const bool known = hxal_lport_get_attr(ioc, 0, lpwwn, &attributes) == HXA_STATUS_OK;
    const auto callback = reinterpret_cast<hxal_lport_snia_cbfn_t>(registration.callback);
    callback(registration.userData, lpwwn, snia_code(event), known ? attributes.pid : 0);
    return HXA_STATUS_OK;
}

hxa_status_t call_itnim(const Registration& registration, const Event& event)
{
    if (!wants_short(registration))
        return call_full<hxa_itnim_aen_data_t>(registration, event);
    const hxa_itnim_aen_data_t& data = event.aen_data.itnim;
    const auto callback = reinterpret_cast<hxal_itnim_snia_cbfn_t>(registration.callback);
    callback(registration.userData, data.lpwwn, data.rpwwn, snia_code(event));
    return HXA_STATUS_OK;
}

// Of every kind in the order in which their descriptors are collected.
// clang-format off
constinit hxal::Kind kinds[] = {
    // category            which events    how called                         tells unknown handles
    {HXA_AEN_CAT_ADAPTER, is_for_adapter, call_adapter,                      false},
    {HXA_AEN_CAT_LPORT,   is_for_lport,   call_lport,                        false},
    {HXA_AEN_CAT_ITNIM,   is_for_itnim,   call_itnim,                        false},
    {HXA_AEN_CAT_PORT,    is_for_port,    call_full<hxa_port_aen_data_t>,    true},
    {HXA_AEN_CAT_RPORT,   is_for_rport,   call_full<hxa_rport_aen_data_t>,   true},
    {HXA_AEN_CAT_AUDIT,   is_for_audit,   call_full<hxa_audit_aen_data_t>,   true},
    {HXA_AEN_CAT_IOC,     is_for_ioc,     call_full<hxa_ioc_aen_data_t>,     true},
    {HXA_AEN_CAT_ETHPORT, is_for_ethport, call_full<hxa_ethport_aen_data_t>, true},
};
// clang-format on

} // namespace

hxal::Kind* hxal::kind_of(uint32_t category)
{
    auto* row = std::find_if(std::begin(kinds), std::end(kinds), [=](const Kind& kind) { return kind.category == category; });
    return row == std::end(kinds) ? nullptr : row;
}

void hxal::dispatch_event(const hxa_aen_entry_t& event)
{
    if (Kind* kind = kind_of(event.aen_category))
        kind->registrations.dispatch(event, kind->is_for, kind->call);
}

std::vector<int> hxal::hxal_aen_fd_collect()
{
    std::vector<int> descriptors;
    for (Kind& kind : kinds)
        kind.registrations.collect(descriptors);
    return descriptors;
}
