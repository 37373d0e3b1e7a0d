#include "inventory/hba_info.h"

#include "inventory/address_text.h"
#include "inventory/property_text.h"

namespace zmlr
{

namespace
{

template <std::size_t N, std::size_t M> void copy_trimmed(char (&out)[N], const char (&field)[M])
{
    copy_text(out, field);
    ProviderUtil::trimString(out, out);
}

} // namespace

void fill_ethernet_driver(_hbaInfo& info, const hxa_ioc_attr_t& attributes)
{
    copy_text(info.eth_driver_name, attributes.driver_attr.driver);
    copy_trimmed(info.eth_driver_version, attributes.driver_attr.driver_ver);
}

void fill_fc_driver(_hbaInfo& info, const hxa_ioc_attr_t& attributes)
{
    copy_text(info.fc_driver_name, attributes.driver_attr.driver);
    copy_trimmed(info.fc_driver_version, attributes.driver_attr.driver_ver);
}

void fill_card(_hbaInfo& info, const hxa_ioc_attr_t& attributes)
{
    copy_text(info.serial_number, attributes.adapter_attr.serial_num);
    copy_text(info.manufacturer, attributes.adapter_attr.manufacturer);
    copy_trimmed(info.firmware_version, attributes.driver_attr.fw_ver);
    copy_text(info.model, attributes.adapter_attr.model);
}

} // namespace zmlr
