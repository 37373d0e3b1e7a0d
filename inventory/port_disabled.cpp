#include "inventory/port_disabled.h"

#include "inventory/adapter_lookup.h"
#include "inventory/adapter_walk.h"
#include "inventory/address_text.h"
#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "PortHelper";

constexpr Walk_Row disabled_walk = {.source = log_source, .iocs = Iocs::any};

bool is_mac(const String& address) { return address.size() == ProviderUtil::mac_text_size - 1; }

// The index of the adapter with the address; 0 when there is none.
int adapter_of(const String& address)
{
    if (is_mac(address))
    {
        mac_t mac = {};
        const int adapter =
            ProviderUtil::getRawMacFromStr(address.c_str(), mac.mac) ? static_cast<int>(hxal_adapter_get_by_mac(mac)) : 0;
        if (adapter < 1)
            ZMLR_LOG(LL_ERR, "ERROR: Invalid Adapter Index");
        return adapter;
    }
    wwn_t wwn = 0;
    const bool is_wwn = ProviderUtil::getRawWWNFromStr(address.c_str(), reinterpret_cast<unsigned char*>(&wwn));
    const int adapter = is_wwn ? hxal_adapter_get_by_pwwn(wwn) : 0;
    if (adapter < 1)
        ZMLR_LOG(LL_ERR, "ERROR: Invalid Adapter index");
    return adapter;
}

bool has_address(const Open_Port& port, const String& address)
{
    if (is_mac(address))
        return port.ethernet && ProviderUtil::has_mac(port.ethernet.get(), address);
    return port.fc && ProviderUtil::has_wwn(port.fc.get(), address);
}

bool is_out_of_service(std::uint32_t port_state)
{
    return port_state == HXA_PPORT_ST_DISABLING || port_state == HXA_PPORT_ST_DISABLED;
}

// The state of one side of a port, read by `read`; none, with a log line, when the driver does not tell.
template <class Attributes>
std::optional<std::uint32_t> state_of(const hxal_t* ioc, hxa_status_t (*read)(const hxal_t*, Attributes*), const char* failure)
{
    Attributes attributes = {};
    if (read(ioc, &attributes) == HXA_STATUS_OK)
        return attributes.port_state;
    ZMLR_LOG(LL_ERR, "%s", failure);
    return std::nullopt;
}

bool is_disabled(const Open_Adapter& adapter, const Open_Port& port)
{
    if (port.fc)
    {
        const auto state = state_of(port.fc.get(), hxal_port_get_attr, "hxal_port_get_attr failed");
        if (!state || is_out_of_service(*state))
            return state.has_value();
    }
    if (adapter.is_cna && port.ethernet)
    {
        const auto state = state_of(port.ethernet.get(), hxal_ethport_get_attr, "hxal_ethport_get_attr failed");
        if (!state || is_out_of_service(*state))
            return state.has_value();
    }
    ZMLR_LOG(LL_INFO, "Port Enabled");
    return false;
}

} // namespace

bool isPortDisabled(const String& address)
{
    const Scope_Trace trace(log_source);
    if (address.empty())
    {
        ZMLR_LOG(LL_ERR, "ERROR: Invalid PortAddress");
        return false;
    }
    const int index = adapter_of(address);
    const std::optional<Open_Adapter> adapter = index < 1 ? std::nullopt : open_adapter(disabled_walk, index);
    if (!adapter)
        return false;
    for (Port_Walk ports(disabled_walk, *adapter); ports.next();)
    {
        if (has_address(ports.port(), address))
            return is_disabled(*adapter, ports.port());
    }
    return false;
}

} // namespace zmlr
