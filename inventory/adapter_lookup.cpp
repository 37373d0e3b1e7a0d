#include "inventory/hba_info.h"
#include "inventory/property_text.h"
#include "inventory/provider_util.h"
#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "ProviderUtil";

int adapter_count() { return static_cast<int>(hxal_adapter_get_num()); }

hxal_adapter_t* open_adapter(int adapter)
{
    hxal_adapter_t* opened = hxal_adapter_open_idx(adapter);
    if (!opened)
        ZMLR_LOG(LL_ERR, "Unable to open handle to Adapter id %d", adapter);
    return opened;
}

bool parse_mac(const String& text, mac_t& mac) { return ProviderUtil::getRawMacFromStr(text.c_str(), mac.mac); }

bool parse_wwn(const String& text, wwn_t& wwn)
{
    return ProviderUtil::getRawWWNFromStr(text.c_str(), reinterpret_cast<unsigned char*>(&wwn));
}

bool has_wwn(hxal_t* fc, const String& address)
{
    char text[ProviderUtil::wwn_text_size];
    const wwn_t wwn = hxal_ioc_get_pwwn(fc);
    ProviderUtil::WWN2str(text, &wwn);
    return address.equali(text);
}

bool has_mac(hxal_t* ethernet, const String& address)
{
    char text[ProviderUtil::mac_text_size];
    const mac_t mac = hxal_ioc_get_mac(ethernet);
    ProviderUtil::MAC2str(text, &mac);
    return address.equali(text);
}

hxal_t* find_port(hxal_adapter_t* adapter, int ports, const String& address, bool is_wwn)
{
    for (int port = 0; port < ports; port++)
    {
        hxal_t* ioc = is_wwn ? hxal_adapter_get_fcioc(adapter, port) : hxal_adapter_get_ethioc(adapter, port);
        if (ioc && (is_wwn ? has_wwn(ioc, address) : has_mac(ioc, address)))
            return ioc;
    }
    return nullptr;
}

} // namespace

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

String ProviderUtil::getAddrByAdapterId(int adapter)
{
    const Scope_Trace trace(log_source);
    const hxal_adapter_t* opened = open_adapter(adapter);
    const bool is_cna = hxal_adapter_is_cna_capable(adapter) != HXA_FALSE;
    const hxal_t* fc = hxal_adapter_get_fcioc(opened, 0);
    const hxal_t* ethernet = is_cna ? hxal_adapter_get_ethioc(opened, 0) : nullptr;
    if (!fc && !ethernet)
        return String();

    char text[wwn_text_size];
    if (is_cna)
    {
        const mac_t mac = read_cna_mac(fc, ethernet);
        MAC2str(text, &mac);
    }
    else
    {
        const wwn_t wwn = hxal_ioc_get_nwwn(fc);
        WWN2str(text, &wwn);
    }
    return text;
}

hxal_t* ProviderUtil::getHxalHandlerByAdapterId(int adapter)
{
    const Scope_Trace trace(log_source);
    if (adapter < 0 || adapter > adapter_count())
    {
        ZMLR_LOG(LL_ERR, "Invalid adapter id.");
        return nullptr;
    }
    hxal_adapter_t* opened = open_adapter(adapter);
    const int ports = opened ? hxal_adapter_get_num_port(adapter) : 0;
    for (int port = 0; port < ports; port++)
    {
        if (hxal_t* ethernet = hxal_adapter_get_ethioc(opened, port))
            return ethernet;
        if (hxal_t* fc = hxal_adapter_get_fcioc(opened, port))
            return fc;
    }
    return nullptr;
}

hxal_t* ProviderUtil::getHxalHandlerByPortAddress(const String& address, bool is_wwn)
{
    const Scope_Trace trace(log_source);
    const int adapters = adapter_count();
    if (adapters == 0)
        ZMLR_LOG(LL_WARN, "No adapters in the system!");

    for (int index = 1; index <= adapters; index++)
    {
        hxal_adapter_t* adapter = open_adapter(index);
        if (!adapter)
            return nullptr;

        const int ports = hxal_adapter_get_num_port(index);
        if (ports <= 0)
        {
            ZMLR_LOG(LL_WARN, "Number of ports in adapter %d = %d", index, ports);
            ZMLR_LOG(LL_WARN, "Continuing with the next adapter");
        }
        else if (hxal_t* ioc = find_port(adapter, ports, address, is_wwn))
            return ioc;
    }
    return nullptr;
}

String ProviderUtil::getEthDeviceNameByMAC(const String& mac)
{
    const Scope_Trace trace(log_source);
    mac_t raw = {};
    const int index = parse_mac(mac, raw) ? hxal_ioc_get_idx_by_mac(raw) : -1;
    hxal_t* ioc = index >= 0 ? hxal_ioc_open_idx(index) : nullptr;
    return ioc ? property_text(hxal_ioc_get_eth_name(ioc), sizeof ioc->eth_name) : String();
}

} // namespace zmlr
