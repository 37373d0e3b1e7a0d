#include "inventory/hba_info.h"

#include "inventory/property_text.h"
#include "runtime/log.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "AdapterHelper";

// One IOC of an adapter with its attributes.
struct Ioc_Reading
{
    Ioc_Handle ioc;
    hxa_ioc_attr_t attributes = {};
    bool is_read = false;
};

struct Adapter_Reading
{
    Ioc_Reading ethernet;
    Ioc_Reading fc;
};

void read(Ioc_Reading& reading, hxal_t* ioc)
{
    reading.ioc.reset(ioc);
    reading.is_read = ioc && hxal_ioc_get_attr(ioc, &reading.attributes) == HXA_STATUS_OK;
}

bool read(Adapter_Reading& reading, hxal_adapter_t* adapter, int index, bool is_cna)
{
    hxal_t* ethernet = is_cna ? hxal_adapter_get_ethioc(adapter, 0) : nullptr;
    if (is_cna && !ethernet)
        ZMLR_LOG(LL_WARN, "hxal_adapter_get_ethioc failed for adapter Index: %d", index);
    hxal_t* fc = hxal_adapter_get_fcioc(adapter, 0);
    if (!fc)
        ZMLR_LOG(LL_WARN, "hxal_adapter_get_fcioc failed for adapter Index: %d", index);
    if (!ethernet && !fc)
    {
        ZMLR_LOG(LL_WARN, "no ioc retrieved for adapter Index: %d", index);
        return false;
    }

    read(reading.ethernet, ethernet);
    read(reading.fc, fc);
    if (!reading.ethernet.is_read && !reading.fc.is_read)
    {
        ZMLR_LOG(LL_WARN, "hxal_ioc_get_attr falied for both fc and eth");
        return false;
    }
    return true;
}

template <std::size_t N, std::size_t M> void copy_trimmed(char (&out)[N], const char (&field)[M])
{
    copy_text(out, field);
    ProviderUtil::trimString(out, out);
}

void fill_card(_hbaInfo& info, const hxa_ioc_attr_t& attributes)
{
    copy_text(info.serial_number, attributes.adapter_attr.serial_num);
    copy_text(info.manufacturer, attributes.adapter_attr.manufacturer);
    copy_text(info.model, attributes.adapter_attr.model);
    copy_trimmed(info.firmware_version, attributes.driver_attr.fw_ver);
}

void fill_ethernet_side(_hbaInfo& info, const Ioc_Reading& ethernet, int index)
{
    if (!ethernet.is_read)
    {
        ZMLR_LOG(LL_ERR, "hxal_ioc_get_attr call to fill eth attributes failed for Adapter id %d", index);
        return;
    }
    copy_text(info.eth_driver_name, ethernet.attributes.driver_attr.driver);
    copy_trimmed(info.eth_driver_version, ethernet.attributes.driver_attr.driver_ver);
}

void fill_fc_side(_hbaInfo& info, const Ioc_Reading& fc, int index)
{
    const wwn_t wwn = hxal_ioc_get_nwwn(fc.ioc.get());
    ProviderUtil::WWN2str(info.node_wwn, &wwn);

    if (!fc.is_read)
    {
        ZMLR_LOG(LL_ERR, "hxal_ioc_get_attr call to fill fc attributes failed for Adapter id %d", index);
        return;
    }
    copy_text(info.fc_driver_name, fc.attributes.driver_attr.driver);
    copy_trimmed(info.fc_driver_version, fc.attributes.driver_attr.driver_ver);
}

} // namespace

mac_t read_cna_mac(const hxal_t* fc, const hxal_t* ethernet)
{
    if (!fc)
        return hxal_ioc_get_mac(ethernet);

    hxa_ioctl_ioc_info_t info = {};
    if (hxal_ioc_get_info(fc, &info) == HXA_STATUS_OK)
        return info.mac;
    ZMLR_LOG(LL_WARN, "hxal_ioc_get_info() failed");
    ZMLR_LOG(LL_INFO, "Using hxal_ioc_get_mac() to get Mac address");
    return hxal_ioc_get_mac(fc);
}

std::optional<_hbaInfo> read_hba_info(int index)
{
    hxal_adapter_t* adapter = hxal_adapter_open_idx(index);
    if (!adapter)
    {
        ZMLR_LOG(LL_INFO, "Unable to open handle to Adapter id %d", index);
        return std::nullopt;
    }
    const bool is_cna = hxal_adapter_is_cna_capable(index) != HXA_FALSE;
    ZMLR_LOG(LL_INFO, "Adapter Type : %s", is_cna ? "CNA" : "FC HBA");
    if (hxal_adapter_get_num_port(index) <= 0)
    {
        ZMLR_LOG(LL_WARN, "There are no ports associated to Adapter id %d", index);
        return std::nullopt;
    }

    Adapter_Reading reading;
    if (!read(reading, adapter, index, is_cna))
        return std::nullopt;

    _hbaInfo info;
    info.is_cna = is_cna;
    fill_card(info, (reading.ethernet.is_read ? reading.ethernet : reading.fc).attributes);
    if (reading.ethernet.ioc)
        fill_ethernet_side(info, reading.ethernet, index);
    if (is_cna)
    {
        const mac_t mac = read_cna_mac(reading.fc.ioc.get(), reading.ethernet.ioc.get());
        ProviderUtil::MAC2str(info.mac, &mac);
    }
    if (reading.fc.ioc)
        fill_fc_side(info, reading.fc, index);
    return info;
}

} // namespace zmlr
