// Requests to one I/O controller.
#include "sim/command_table.h"
#include "sim/record_fields.h"

namespace hxasim
{

namespace
{

// PCI vendor identifier of the simulated cards, one that no vendor was given.
constexpr std::uint16_t vendor_id = 0x7A6C;

bool is_fibre_channel(const Ioc& ioc) { return ioc.type != HXA_IOC_TYPE_LL; }

const Mac& mac_of(const Ioc& ioc) { return is_fibre_channel(ioc) ? ioc.port->fcoe_mac : ioc.port->mac; }

void put_addresses(hxa_ioctl_ioc_info_t& record, const Ioc& ioc)
{
    const auto& port = *ioc.port;
    if (is_fibre_channel(ioc))
    {
        put_address(record.pwwn, port.pwwn);
        put_address(record.nwwn, port.nwwn);
        put_address(record.factorypwwn, port.factory_pwwn);
        put_address(record.factorynwwn, port.factory_nwwn);
        put_address(record.mac, port.fcoe_mac);
        put_address(record.factory_mac, port.fcoe_factory_mac);
        put_address(record.current_mac, port.fcoe_mac);
        return;
    }
    put_address(record.mac, port.mac);
    put_address(record.factory_mac, port.factory_mac);
    put_address(record.current_mac, port.current_mac);
    put_text(record.eth_name, port.eth_name);
}

void put_vpd(hxa_mfg_vpd_t& field, const Vpd& vpd)
{
    field.version = vpd.version;
    std::memcpy(field.vpd_sig, "VPD", sizeof(field.vpd_sig));
    field.vendor = vpd.vendor;
    std::copy(vpd.data.begin(), vpd.data.end(), field.data);
}

void put_card(hxa_adapter_attr_t& field, const Ioc& ioc)
{
    const auto& adapter = *ioc.adapter;
    put_text(field.manufacturer, adapter.manufacturer);
    put_text(field.serial_num, adapter.serial);
    put_text(field.model, adapter.model);
    put_text(field.model_descr, adapter.model_descr);
    put_text(field.hw_ver, adapter.hw_version);
    put_text(field.fw_ver, adapter.firmware_version);
    put_text(field.optrom_ver, adapter.bios_version);
    put_text(field.os_type, adapter.os_type);
    put_vpd(field.vpd, adapter.vpd);
    if (is_fibre_channel(ioc))
    {
        put_address(field.pwwn, ioc.port->pwwn);
        put_text(field.node_symname, ioc.port->symbolic_name);
    }
    put_address(field.mac, mac_of(ioc));
    field.nports = static_cast<std::uint8_t>(adapter.ports.size());
    field.max_speed = adapter.max_speed;
    field.asic_rev = 'C';
    field.pcie_gen = 2;
    field.pcie_lanes_orig = 8;
    field.pcie_lanes = 8;
    field.cna_capable = adapter.cna_capable;
    field.is_mezz = adapter.is_mezz;
}

void put_software(hxa_ioc_driver_attr_t& field, const Ioc& ioc)
{
    const auto& adapter = *ioc.adapter;
    put_text(field.driver, ioc.node == Node::hxa ? "hxa" : "hxn");
    put_text(field.driver_ver, ioc.node == Node::hxa ? adapter.fc_driver_version : adapter.eth_driver_version);
    put_text(field.fw_ver, adapter.firmware_version);
    put_text(field.bios_ver, adapter.bios_version);
    put_text(field.efi_ver, adapter.efi_version);
    put_text(field.ob_ver, adapter.fcode_version);
}

void put_pci(hxa_ioc_pci_attr_t& field, const Ioc& ioc)
{
    field.vendor_id = vendor_id;
    field.device_id = ioc.adapter->device_id;
    field.ssid = ioc.adapter->device_id;
    field.ssvid = vendor_id;
    field.pcifn = ioc.pci_function;
    put_text(field.chip_rev, ioc.adapter->hw_version);
}

} // namespace

void answer_ioc_info(Call& call, hxa_ioctl_ioc_info_t& record)
{
    const auto& ioc = *call.ioc;
    const auto& adapter = *ioc.adapter;
    put_text(record.serialnum, adapter.serial);
    put_text(record.hwpath, adapter.hwpath + "." + std::to_string(ioc.pci_function));
    put_text(record.adapter_hwpath, adapter.hwpath);
    put_text(record.name, adapter.name);
    put_text(record.port_name, ioc.port->name);
    put_addresses(record, ioc);
    record.ioc_type = ioc.type;
}

void answer_ioc_attributes(Call& call, hxa_ioctl_ioc_attr_t& record)
{
    const auto& ioc = *call.ioc;
    record.attr.ioc_type = ioc.type;
    record.attr.state = *ioc.state;
    record.attr.port_id = ioc.port_number;
    put_card(record.attr.adapter_attr, ioc);
    put_software(record.attr.driver_attr, ioc);
    put_pci(record.attr.pci_attr, ioc);
}

} // namespace hxasim
