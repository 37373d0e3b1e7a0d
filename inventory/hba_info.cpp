#include "inventory/hba_info.h"

#include "inventory/address_text.h"
#include "inventory/fru_number.h"
#include "inventory/property_text.h"

namespace zmlr
{

void fill_ethernet_driver(_hbaInfo& info, const hxa_ioc_attr_t& attributes)
{
    copy_text(info.eth_driver_name, attributes.driver_attr.driver);
    ProviderUtil::copy_trimmed(info.eth_driver_version, attributes.driver_attr.driver_ver);
}

void fill_fc_driver(_hbaInfo& info, const hxa_ioc_attr_t& attributes)
{
    copy_text(info.fc_driver_name, attributes.driver_attr.driver);
    ProviderUtil::copy_trimmed(info.fc_driver_version, attributes.driver_attr.driver_ver);
}

void fill_card(_hbaInfo& info, const hxa_ioc_attr_t& attributes)
{
    copy_text(info.serial_number, attributes.adapter_attr.serial_num);
    copy_text(info.manufacturer, attributes.adapter_attr.manufacturer);
    ProviderUtil::copy_trimmed(info.firmware_version, attributes.driver_attr.fw_ver);
    copy_text(info.model, attributes.adapter_attr.model);
}

void fill_fru_number(_hbaInfo& info, const hxa_ioc_attr_t& fc_attributes)
{
    const String fru_number = getFRUNumber(fc_attributes.adapter_attr.vpd);
    copy_text(info.fru_number, sizeof info.fru_number, fru_number.c_str(), fru_number.size());
}

void fill_boot_code(_hbaInfo& info, const hxa_ioc_attr_t& fc_attributes)
{
    ProviderUtil::copy_trimmed(info.boot_code_version, fc_attributes.driver_attr.bios_ver);
}

} // namespace zmlr
