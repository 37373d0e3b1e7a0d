#include "indications/event_registrations.h"

#include "indications/event_callbacks.h"
#include "inventory/address_text.h"
#include "inventory/property_text.h"
#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "IndicationHelper";

// Asked for with adapters: the library's own short form of their callbacks is not wanted.
constexpr uint32_t full_form = 2;

constexpr const char* any_adapter = "any"; // stands for the serial number of what is yet to come

constexpr Walk_Row all_adapters = {
    .source = log_source,
    .iocs = Iocs::any,
    .count = {LL_INFO, "Number of adapters: %d"},
    .none = {LL_ERR, "No adapters are found! Registration did NOT happen."},
    .not_opened = {LL_ERR, "Unable to open handle to Adapter id : %d"},
    .not_opened_remark = {LL_INFO, "Continuing with the next Adapter."},
};

// What is logged when an object is unregistered.
struct Unregister_Row
{
    const char* begin;
    const char* done;
    const char* failed;
};

// clang-format off
constexpr Unregister_Row adapter_row = {
    "Unregistering adapter event registraton for serial no = %s",
    "Unregisteration for adapter event registration for serial no = %s is successful.",
    "Unregisteration for adapter event for serial no = %s failed."};
constexpr Unregister_Row port_row = {
    "Unregistering port event registraton for WWN = %s",
    "Unregisteration for port event registration for PWWN = %s successful.",
    "Unregisteration for port event registration for PWWN = %s failed."};
constexpr Unregister_Row ethernet_port_row = {
    "Unregistering eth port event registraton for MAC = %s",
    "Unregisteration for eth port event registration for MAC = %s is successful.",
    "Unregisteration for eth port event registration for MAC = %s failed."};
constexpr Unregister_Row audit_row = {
    "Unregistering audit event registraton for port WWN = %s",
    "Unregisteration for audit event registration for PWWN = %s is successful.",
    "Unregisteration for audit event registration for PWWN = %s failed."};
// clang-format on

// Adds what `call` registers for the object. There is room for it before it is registered: it must not be forgotten.
template <class List, class Call>
void enlist(List& list, const String& object, const Call& call, Log_Level level, const char* failure)
{
    list.push_back({object, nullptr});
    if (call(&list.back().handle) == HXA_STATUS_OK)
        return;
    list.pop_back();
    ZMLR_LOG(level, "%s", failure);
}

template <class List, class Call> bool delist(List& list, const Unregister_Row& row, const Call& call)
{
    bool all = true;
    for (const auto& [object, handle] : list)
    {
        ZMLR_LOG(LL_INFO, row.begin, object.c_str());
        const bool done = call(handle) == HXA_STATUS_OK;
        ZMLR_LOG(done ? LL_INFO : LL_ERR, done ? row.done : row.failed, object.c_str());
        all = all && done;
    }
    list = {};
    return all;
}

void throw_away_events(const hxal_t* ioc)
{
    hxa_aen_entry_t events[HXA_AEN_MAX_ENTRIES];
    int count = HXA_AEN_MAX_ENTRIES;
    hxal_aen_get_events(ioc, events, &count, hxa_aen_app_cim);
}

} // namespace

void Event_Registrations::register_added_adapters()
{
    ZMLR_LOG(LL_INFO, "Registering for Adapter Add events.");
    const auto call = [](auto** handle)
    { return hxal_adapter_aen_register(nullptr, adapterEventCallback, nullptr, handle, full_form); };
    enlist(_adapters, any_adapter, call, LL_WARN, "ERROR: Registration for Adapter Add events FAILED.");
}

void Event_Registrations::register_adapter(const Open_Adapter& adapter)
{
    ZMLR_LOG(LL_INFO, "Adapter Number : %d & Type : %s", adapter.index, adapter.is_cna ? "CNA" : "FC HBA");
    ZMLR_LOG(LL_INFO, "Registering for Adapter Remove events.");
    const auto call = [&](auto** handle)
    { return hxal_adapter_aen_register(adapter.handle, adapterEventCallback, nullptr, handle, full_form); };
    enlist(_adapters, property_text(adapter.handle->serial_num), call, LL_WARN,
           "ERROR: Registration for Adapter Remove events FAILED.");
}

void Event_Registrations::register_ethernet_port(const hxal_t* ioc)
{
    ZMLR_LOG(LL_INFO, "IOC TYPE = ETH");
    const String mac = ProviderUtil::mac_text(hxal_ioc_get_mac(ioc));
    ZMLR_LOG(LL_INFO, "Discarding non-consumed events of Eth Port: %s", mac.c_str());
    throw_away_events(ioc);
    ZMLR_LOG(LL_INFO, "Registering for events for Eth Port: %s", mac.c_str());
    const auto call = [&](auto** handle)
    { return hxal_ethport_aen_register(ioc, ethPortEventCallback, nullptr, nullptr, handle); };
    enlist(_ethernet_ports, mac, call, LL_ERR, "ERROR: Registration for Eth Port events FAILED.");
}

void Event_Registrations::register_fc_port(const hxal_t* ioc)
{
    ZMLR_LOG(LL_INFO, "IOC TYPE = FC");
    const wwn_t pwwn = hxal_ioc_get_pwwn(ioc);
    const String wwn = ProviderUtil::wwn_text(pwwn);
    ZMLR_LOG(LL_INFO, "Discarding non-consumed events of FC Port: %s", wwn.c_str());
    throw_away_events(ioc);
    ZMLR_LOG(LL_INFO, "Registering for events for FC Port: %s", wwn.c_str());

    hxa_port_aen_data_t port = {};
    port.pwwn = pwwn;
    const auto call = [&](auto** handle) { return hxal_port_aen_register(ioc, pPortEventCallback, nullptr, &port, handle); };
    enlist(_ports, wwn, call, LL_ERR, "ERROR: Registration for FC Port events FAILED.");

    const hxa_audit_aen_data_t audit = {.pwwn = pwwn};
    const auto audit_call = [&](auto** handle)
    { return hxal_audit_aen_register(ioc, auditEventCallback, nullptr, &audit, handle); };
    enlist(_audits, wwn, audit_call, LL_ERR, "ERROR: Registration for Audit events FAILED.");
}

void Event_Registrations::register_port(const Open_Port& port)
{
    if (port.ethernet)
        register_ethernet_port(port.ethernet.get());
    if (port.fc)
        register_fc_port(port.fc.get());
}

bool Event_Registrations::register_all()
{
    register_added_adapters();
    Adapter_Walk adapters(all_adapters);
    if (adapters.count() == 0)
        return false;
    while (adapters.next())
    {
        const Open_Adapter& adapter = adapters.adapter();
        register_adapter(adapter);
        ZMLR_LOG(LL_INFO, "Number of ports: %d", adapter.ports);
        for (int index = 0; index < adapter.ports; index++)
        {
            ZMLR_LOG(LL_INFO, "Registering for events for port : %d\n", index);
            if (const std::optional<Open_Port> port = open_port(all_adapters, adapter, index))
                register_port(*port);
        }
    }
    return true;
}

bool Event_Registrations::registerForEvents()
{
    const Scope_Trace trace(log_source);
    struct Unregister
    {
        void operator()(Event_Registrations* registrations) const { registrations->unregister_all(); }
    };
    std::unique_ptr<Event_Registrations, Unregister> unfinished(this);
    if (!register_all())
        return false;

    ZMLR_LOG(LL_INFO, "invoking hxal_aen_init()");
    if (const hxa_status_t status = hxal_aen_init(); status != HXA_STATUS_OK)
    {
        ZMLR_LOG(LL_ERR, "Unable to initialize the Asynchronous Event Notification. ret = %d", static_cast<int>(status));
        return false;
    }
    static_cast<void>(unfinished.release());
    return true;
}

bool Event_Registrations::deRegisterForEvents()
{
    const Scope_Trace trace(log_source);
    ZMLR_LOG(LL_INFO, "invoking hxal_aen_exit()");
    hxal_aen_exit();
    return unregister_all();
}

bool Event_Registrations::unregister_all()
{
    const bool adapters = delist(_adapters, adapter_row, hxal_adapter_aen_unregister);
    const bool ports = delist(_ports, port_row, hxal_port_aen_unregister);
    const bool ethernet_ports = delist(_ethernet_ports, ethernet_port_row, hxal_ethport_aen_unregister);
    const bool audits = delist(_audits, audit_row, hxal_audit_aen_unregister);
    return adapters && ports && ethernet_ports && audits;
}

} // namespace zmlr
