#include "indications/event_callbacks.h"

#include "indications/alert.h"
#include "indications/alert_host.h"
#include "indications/event_index.h"
#include "indications/indication_helper.h"
#include "indications/object_paths.h"
#include "indications/severity.h"
#include "inventory/adapter_lookup.h"
#include "inventory/address_text.h"
#include "runtime/log.h"
#include "runtime/trace.h"

#include <cstdio>
#include <exception>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "IndicationHelper";

using Alert = Ref<ZEMLAR_AlertIndication>;

// Each kind of event that makes alerts.
struct Event_Kind
{
    hxa_aen_category_t category;
    const char* name; // in the alert
    const char* not_in_table;
};

// clang-format off
constexpr Event_Kind of_port     = {HXA_AEN_CAT_PORT,    "Port",    "The Port event callback invoked with event id not in the event message array."};
constexpr Event_Kind of_audit    = {HXA_AEN_CAT_AUDIT,   "Audit",   "The Audit event callback invoked with event id not in the event message array."};
constexpr Event_Kind of_ethernet = {HXA_AEN_CAT_ETHPORT, "EthPort", "The EthPort event callback invoked with event id not in the event message array."};
// clang-format on

// The event thread's own. When a thread ends and another one starts, the library orders them.
constinit Alert_Host host;

// A port's address, without a need for memory.
struct Wwn_Text
{
    explicit Wwn_Text(wwn_t wwn) { ProviderUtil::WWN2str(text, &wwn); }
    char text[ProviderUtil::wwn_text_size];
};

// The shell of a callback: the alert that `build` makes of the event's row in the message table, if any, is left to be delivered.
template <class Build> void raise(const Event_Kind& kind, uint32_t event, const Build& build) noexcept
try
{
    int index = 0;
    if (!getEventIndexInArray(kind.category, event_id(kind.category, event), &index))
    {
        ZMLR_LOG(LL_INFO, "%s", kind.not_in_table);
        return;
    }
    if (Alert alert = build(hxal_aen_msg_array[index]))
        IndicationHelper::getIndicationHelperInstance().updateIndicationObjects(std::move(alert));
}
catch (const std::exception& exception)
{
    ZMLR_LOG(LL_ERR, "An event makes no alert: %s", exception.what());
}

Alert fc_port_alert(const hxal_aen_msg_t& row, const Event_Kind& kind, const String& wwn)
{
    const String system = host.text();
    return new_alert(row, kind.name, system, getFCPortObjectPath(system, wwn));
}

// Optical monitoring tells its events' level in numbers of their own: those of a module's health count from 2.
const char* level_text(int level)
{
    constexpr const char* levels[] = {"Unknown", "Green", "Amber", "Red"};
    return levels[level >= 1 && level <= 3 ? level : 0];
}

String decimal(int number)
{
    char text[16];
    std::snprintf(text, sizeof text, "%d", number);
    return text;
}

Alert port_alert(const hxal_aen_msg_t& row, uint32_t event, const hxa_port_aen_data_t& data, const String& wwn)
{
    Alert alert = fc_port_alert(row, of_port, wwn);
    switch (event)
    {
    case HXA_PORT_AEN_RLIR:
        ZMLR_LOG(LL_WARN, "Not supported event is triggered.");
        return {};
    case HXA_PORT_AEN_SFP_POM:
        set_message(*alert.ptr(), row.format, level_text(data.level), wwn);
        alert->MessageArguments.set({decimal(data.level), wwn});
        return alert;
    case HXA_PORT_AEN_FABRIC_NAME_CHANGE:
        set_message(*alert.ptr(), row.format, wwn, ProviderUtil::wwn_text(data.fwwn));
        return alert;
    default:
        set_message(*alert.ptr(), row.format, wwn);
        return alert;
    }
}

Alert audit_alert(const hxal_aen_msg_t& row, const String& wwn)
{
    Alert alert = fc_port_alert(row, of_audit, wwn);
    set_message(*alert.ptr(), row.format, wwn);
    return alert;
}

// Switching an interface is told in DMTF's words, about the interface and its host.
void set_switched(ZEMLAR_AlertIndication& alert, const char* format, Perceived_Severity severity, const String& mac,
                  const String& system)
{
    const String interface = ProviderUtil::getEthDeviceNameByMAC(mac);
    set_message(alert, format, interface);
    alert.MessageArguments.set({interface, getComputerSystemObjectPath(system)});
    alert.OwningEntity.set("DMTF");
    alert.PerceivedSeverity.set(severity);
    alert.AlertType.set(ALERT_TYPE_COMMUNICATIONS);
    alert.OtherAlertType.set("");
}

Alert ethernet_alert(const hxal_aen_msg_t& row, uint32_t event, const hxa_ethport_aen_data_t& data, const String& mac)
{
    const String system = host.text();
    Alert alert = new_alert(row, of_ethernet.name, system, getEthernetPortObjectPath(system, mac));
    switch (event)
    {
    case HXA_ETHPORT_AEN_LINKUP:
        set_message(*alert.ptr(), row.format, mac, hxal_ethport_cee_state_to_string(data.cee_state));
        return alert;
    case HXA_ETHPORT_AEN_LINKDOWN:
        set_message(*alert.ptr(), row.format, mac);
        alert->PerceivedSeverity.set(SEVERITY_CRITICAL);
        return alert;
    case HXA_ETHPORT_AEN_ENABLE:
        set_switched(*alert.ptr(), "The network port %s has been enabled", SEVERITY_INFORMATION, mac, system);
        return alert;
    case HXA_ETHPORT_AEN_DISABLE:
        set_switched(*alert.ptr(), "The network port %s has been disabled", SEVERITY_WARNING, mac, system);
        return alert;
    default:
        ZMLR_LOG(LL_WARN, "Not supported Eth event is triggered.");
        return {};
    }
}

} // namespace

void adapterEventCallback(void*, uint32_t, const hxa_adapter_aen_data_t*, hxa_timeval_t) noexcept
{
    const Scope_Trace trace(log_source);
}

void pPortEventCallback(void*, uint32_t event, const hxa_port_aen_data_t* data, hxa_timeval_t) noexcept
{
    const Scope_Trace trace(log_source);
    const Wwn_Text wwn(data->pwwn);
    raise(of_port, event, [&](const hxal_aen_msg_t& row) { return port_alert(row, event, *data, wwn.text); });
}

void auditEventCallback(void*, uint32_t event, const hxa_audit_aen_data_t* data, hxa_timeval_t) noexcept
{
    const Scope_Trace trace(log_source);
    const Wwn_Text wwn(data->pwwn);
    raise(of_audit, event, [&](const hxal_aen_msg_t& row) { return audit_alert(row, wwn.text); });
}

void ethPortEventCallback(void*, uint32_t event, const hxa_ethport_aen_data_t* data, hxa_timeval_t) noexcept
{
    const Scope_Trace trace(log_source);
    char mac[ProviderUtil::mac_text_size];
    ProviderUtil::MAC2str(mac, &data->mac);
    raise(of_ethernet, event, [&](const hxal_aen_msg_t& row) { return ethernet_alert(row, event, *data, mac); });
}

} // namespace zmlr
