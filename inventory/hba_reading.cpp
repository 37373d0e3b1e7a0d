#include "inventory/hba_reading.h"

#include "inventory/address_text.h"
#include "inventory/property_text.h"
#include "runtime/log.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "AdapterHelper";

void read(Ioc_Attributes& attributes, hxal_t* ioc)
{
    attributes.are_read = ioc && hxal_ioc_get_attr(ioc, &attributes.value) == HXA_STATUS_OK;
    if (!attributes.are_read)
        attributes.value = {}; // a refusal may have come with any bytes
}

void take_ethernet(Hba_Reading& reading)
{
    if (reading.ethernet.are_read)
    {
        fill_ethernet_driver(reading.info, reading.ethernet.value);
        fill_card(reading.info, reading.ethernet.value);
        fill_fru_number(reading.info, reading.fc.value);
        return;
    }
    ZMLR_LOG(LL_ERR, "hxal_ioc_get_attr call to fill eth attributes failed for Adapter id %d", reading.port.adapter);
    reading.port.ethernet.reset();
}

void take_mac(Hba_Reading& reading)
{
    const mac_t mac = read_cna_mac(reading.port.fc.get(), reading.port.ethernet.get());
    ProviderUtil::MAC2str(reading.info.mac, &mac);
}

void take_fc(Hba_Reading& reading)
{
    const wwn_t wwn = hxal_ioc_get_nwwn(reading.port.fc.get());
    ProviderUtil::WWN2str(reading.info.node_wwn, &wwn);

    if (reading.fc.are_read)
    {
        fill_fc_driver(reading.info, reading.fc.value);
        if (!reading.ethernet.are_read)
        {
            fill_card(reading.info, reading.fc.value);
            fill_fru_number(reading.info, reading.fc.value);
        }
        return;
    }
    ZMLR_LOG(LL_ERR, "hxal_ioc_get_attr call to fill fc attributes failed for Adapter id %d", reading.port.adapter);
    reading.port.fc.reset();
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

std::optional<Hba_Reading> read_hba(const Open_Adapter& adapter, Open_Port port, const Inventory_Request& request)
{
    Hba_Reading reading = {.port = std::move(port)};
    read(reading.ethernet, reading.port.ethernet.get());
    read(reading.fc, reading.port.fc.get());
    if (!reading.ethernet.are_read && !reading.fc.are_read)
    {
        ZMLR_LOG(LL_WARN, "hxal_ioc_get_attr falied for both fc and eth");
        return std::nullopt;
    }

    copy_text(reading.info.host, request.host.text());
    reading.info.is_cna = adapter.is_cna;
    if (reading.port.ethernet)
        take_ethernet(reading);
    if (adapter.is_cna)
        take_mac(reading);
    if (reading.port.fc)
        take_fc(reading);
    return reading;
}

} // namespace zmlr
