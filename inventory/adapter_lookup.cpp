#include "inventory/adapter_lookup.h"

#include "inventory/adapter_walk.h"
#include "inventory/address_text.h"
#include "inventory/hba_reading.h"
#include "inventory/property_text.h"
#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "ProviderUtil";

constexpr Walk_Line not_opened = {LL_ERR, "Unable to open handle to Adapter id %d"};

constexpr Walk_Row port_0_of_card = {.source = log_source, .iocs = Iocs::of_card, .not_opened = not_opened};

constexpr Walk_Row first_ioc = {.source = log_source, .iocs = Iocs::any, .not_opened = not_opened};

constexpr Walk_Row first_answer = {.source = log_source, .iocs = Iocs::any, .none = {LL_WARN, "No adapters in the system!"}};

constexpr Walk_Row by_address(Iocs iocs)
{
    return {
        .source = log_source,
        .iocs = iocs,
        .ends_at_unopened = true,
        .none = {LL_WARN, "No adapters in the system!"},
        .not_opened = not_opened,
        .no_ports = {LL_WARN, "Number of ports in adapter %d = %d"},
        .no_ports_remark = {LL_WARN, "Continuing with the next adapter"},
    };
}

constexpr Walk_Row by_wwn = by_address(Iocs::fc);
constexpr Walk_Row by_mac = by_address(Iocs::ethernet);

bool parse_mac(const String& text, mac_t& mac)
{
    return text.size() == ProviderUtil::mac_text_size - 1 && ProviderUtil::getRawMacFromStr(text.c_str(), mac.mac);
}

bool parse_wwn(const String& text, wwn_t& wwn)
{
    return text.size() == ProviderUtil::wwn_text_size - 1 &&
           ProviderUtil::getRawWWNFromStr(text.c_str(), reinterpret_cast<unsigned char*>(&wwn));
}

bool read_attributes(hxal_t* ioc, hxa_ioc_attr_t& attributes)
{
    attributes = {};
    return ioc && hxal_ioc_get_attr(ioc, &attributes) == HXA_STATUS_OK;
}

String version_in(const hxa_ioc_attr_t& attributes)
{
    char version[sizeof attributes.driver_attr.driver_ver];
    copy_text(version, attributes.driver_attr.driver_ver);
    ProviderUtil::trimString(version, version);
    return property_text(version);
}

} // namespace

bool ProviderUtil::has_wwn(const hxal_t* fc, const String& address) { return address.equali(wwn_text(hxal_ioc_get_pwwn(fc))); }

bool ProviderUtil::has_mac(const hxal_t* ethernet, const String& address)
{
    return address.equali(mac_text(hxal_ioc_get_mac(ethernet)));
}

int ProviderUtil::getAdapterIdByNWWN(const String& wwn)
{
    const Scope_Trace trace(log_source);
    wwn_t raw = 0;
    const int adapter = parse_wwn(wwn, raw) ? hxal_adapter_get_by_pwwn(raw) : 0;
    if (adapter >= 1)
        return adapter;
    ZMLR_LOG(LL_WARN, "Unable to get Adapter Id for adpater NWWN =%s ", wwn.c_str());
    return -1;
}

int ProviderUtil::getAdapterIdByMacAddr(const String& mac)
{
    const Scope_Trace trace(log_source);
    mac_t raw = {};
    const int adapter = parse_mac(mac, raw) ? static_cast<int>(hxal_adapter_get_by_mac(raw)) : 0;
    if (adapter >= 1)
        return adapter;
    ZMLR_LOG(LL_WARN, "Unable to get Adapter Id for adpater MAC address=%s ", mac.c_str());
    return -1;
}

int ProviderUtil::getAdapterId(const String& address)
{
    const Scope_Trace trace(log_source);
    switch (address.size())
    {
    case wwn_text_size - 1:
        return getAdapterIdByNWWN(address);
    case mac_text_size - 1:
        return getAdapterIdByMacAddr(address);
    default:
        ZMLR_LOG(LL_WARN, "The address passed is not MAC or WWN");
        return -1;
    }
}

String ProviderUtil::getAddrByAdapterId(int index)
{
    const Scope_Trace trace(log_source);
    const std::optional<Open_Adapter> adapter = open_adapter(port_0_of_card, index);
    const std::optional<Open_Port> port = adapter ? open_port(port_0_of_card, *adapter, 0) : std::nullopt;
    if (!port)
        return String();

    return adapter->is_cna ? mac_text(read_cna_mac(port->fc.get(), port->ethernet.get()))
                           : wwn_text(hxal_ioc_get_nwwn(port->fc.get()));
}

hxal_t* ProviderUtil::getHxalHandlerByAdapterId(int index)
{
    const Scope_Trace trace(log_source);
    if (index < 0 || index > static_cast<int>(hxal_adapter_get_num()))
    {
        ZMLR_LOG(LL_ERR, "Invalid adapter id.");
        return nullptr;
    }
    const std::optional<Open_Adapter> adapter = open_adapter(first_ioc, index);
    if (!adapter)
        return nullptr;
    Port_Walk ports(first_ioc, *adapter);
    if (!ports.next())
        return nullptr;
    Open_Port& port = ports.port();
    return port.ethernet ? port.ethernet.release() : port.fc.release();
}

hxal_t* ProviderUtil::getHxalHandlerByPortAddress(const String& address, bool is_wwn)
{
    const Scope_Trace trace(log_source);
    const Walk_Row& row = is_wwn ? by_wwn : by_mac;
    for (Adapter_Walk adapters(row); adapters.next();)
    {
        for (Port_Walk ports(row, adapters.adapter()); ports.next();)
        {
            Open_Port& port = ports.port();
            if (is_wwn && has_wwn(port.fc.get(), address))
                return port.fc.release();
            if (!is_wwn && has_mac(port.ethernet.get(), address))
                return port.ethernet.release();
        }
    }
    return nullptr;
}

hxal_t* ProviderUtil::getHxalHandlerByPortWWN(const String& wwn)
{
    const Scope_Trace trace(log_source);
    return getHxalHandlerByPortAddress(wwn, true);
}

hxal_t* ProviderUtil::getHxalHandlerByPortMAC(const String& mac)
{
    const Scope_Trace trace(log_source);
    return getHxalHandlerByPortAddress(mac, false);
}

String ProviderUtil::getEthDeviceNameByMAC(const String& mac)
{
    const Scope_Trace trace(log_source);
    mac_t raw = {};
    const int index = parse_mac(mac, raw) ? hxal_ioc_get_idx_by_mac(raw) : -1;
    hxal_t* ioc = index >= 0 ? hxal_ioc_open_idx(index) : nullptr;
    return ioc ? property_text(hxal_ioc_get_eth_name(ioc), sizeof ioc->eth_name) : String();
}

String ProviderUtil::getDriverVersion()
{
    const Scope_Trace trace(log_source);
    for (Adapter_Walk adapters(first_answer); adapters.next();)
    {
        for (Port_Walk ports(first_answer, adapters.adapter()); ports.next();)
        {
            hxa_ioc_attr_t attributes;
            if (read_attributes(ports.port().ethernet.get(), attributes) || read_attributes(ports.port().fc.get(), attributes))
                return version_in(attributes);
        }
    }
    return String();
}

} // namespace zmlr
