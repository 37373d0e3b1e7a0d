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

constexpr Walk_Row walk = {.log_source = log_source, .iocs = Iocs::of_card};

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

std::optional<bool> is_fc_disabled(const hxal_t* fc)
{
    hxa_pport_attr_t attributes = {};
    if (hxal_port_get_attr(fc, &attributes) == HXA_STATUS_OK)
        return attributes.port_state == HXA_PPORT_ST_DISABLING || attributes.port_state == HXA_PPORT_ST_DISABLED;
    ZMLR_LOG(LL_ERR, "hxal_port_get_attr failed");
    return std::nullopt;
}

std::optional<bool> is_ethernet_disabled(const hxal_t* ethernet)
{
    hxa_ethport_attr_t attributes = {};
    if (hxal_ethport_get_attr(ethernet, &attributes) == HXA_STATUS_OK)
        return attributes.port_state == HXA_PPORT_ST_DISABLING || attributes.port_state == HXA_PPORT_ST_DISABLED;
    ZMLR_LOG(LL_ERR, "hxal_ethport_get_attr failed");
    return std::nullopt;
}

bool is_disabled(const Open_Port& port)
{
    const std::optional<bool> fc = port.fc ? is_fc_disabled(port.fc.get()) : false;
    if (!fc || *fc)
        return fc.value_or(false);
    const std::optional<bool> ethernet = port.ethernet ? is_ethernet_disabled(port.ethernet.get()) : false;
    if (!ethernet || *ethernet)
        return ethernet.value_or(false);
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
    const std::optional<Open_Adapter> adapter = index < 1 ? std::nullopt : open_adapter(walk, index);
    if (!adapter)
        return false;
    for (Port_Walk ports(walk, *adapter); ports.next();)
    {
        if (has_address(ports.port(), address))
            return is_disabled(ports.port());
    }
    return false;
}

} // namespace zmlr
