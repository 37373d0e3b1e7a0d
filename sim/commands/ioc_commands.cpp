// Requests to one I/O controller.
#include "sim/commands/row.h"
#include "sim/model/record_fields.h"

namespace hxasim
{

namespace
{

// PCI vendor identifier of the simulated cards, one that no vendor was given.
constexpr std::uint16_t vendor_id = 0x7A6C;

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

// An enable or a disable takes its time; who asks for the attributes sees it pass.
void start(Ioc& ioc, hxa_ioc_state_t passing, hxa_ioc_state_t next)
{
    *ioc.state = ioc.port->ioc_settle > 0 ? passing : next;
    ioc.next_state = next;
    ioc.settle = ioc.port->ioc_settle;
}

// The last of the requests that see the passing state is followed by the next one.
std::uint32_t observed_state(Ioc& ioc)
{
    const auto observed = *ioc.state;
    if (ioc.settle > 0 && --ioc.settle == 0)
        *ioc.state = ioc.next_state;
    return observed;
}

void answer_info(Call& call, hxa_ioctl_ioc_info_t& record)
{
    const auto& ioc = *call.ioc;
    const auto& adapter = *ioc.adapter;
    put_text(record.serialnum, adapter.serial);
    put_text(record.hwpath, adapter.hwpath + "." + std::to_string(ioc.pci_function));
    put_text(record.adapter_hwpath, adapter.hwpath);
    put_text(record.name, ioc.adapter_name);
    put_text(record.port_name, ioc.port_name);
    put_addresses(record, ioc);
    record.ioc_type = ioc.type;
}

void answer_ioc_attributes(Call& call, hxa_ioctl_ioc_attr_t& record)
{
    auto& ioc = *call.ioc;
    record.attr.ioc_type = ioc.type;
    record.attr.state = observed_state(ioc);
    record.attr.port_id = ioc.port_number;
    put_card(record.attr.adapter_attr, ioc);
    put_software(record.attr.driver_attr, ioc);
    put_pci(record.attr.pci_attr, ioc);
}

void answer_enable(Call& call, hxa_ioctl_gen_t& record)
{
    auto& ioc = *call.ioc;
    ++ioc.stats.drv_stats.enable_reqs;
    record.status = *ioc.state == HXA_IOC_OPERATIONAL ? HXA_STATUS_IOC_ENABLED : HXA_STATUS_OK;
    if (record.status != HXA_STATUS_OK)
        return;
    ++ioc.stats.drv_stats.ioc_enables;
    ++ioc.stats.drv_stats.enable_replies;
    ++ioc.stats.fw_stats.enable_reqs;
    start(ioc, HXA_IOC_HWINIT, HXA_IOC_OPERATIONAL);
}

void answer_disable(Call& call, hxa_ioctl_gen_t& record)
{
    auto& ioc = *call.ioc;
    ++ioc.stats.drv_stats.disable_reqs;
    record.status = *ioc.state == HXA_IOC_DISABLED ? HXA_STATUS_IOC_DISABLED : HXA_STATUS_OK;
    if (record.status != HXA_STATUS_OK)
        return;
    ++ioc.stats.drv_stats.ioc_disables;
    ++ioc.stats.drv_stats.disable_replies;
    ++ioc.stats.fw_stats.disable_reqs;
    start(ioc, HXA_IOC_DISABLING, HXA_IOC_DISABLED);
}

void answer_ioc_statistics(Call& call, hxa_ioctl_ioc_stats_t& record)
{
    ++call.ioc->stats.fw_stats.stats_reqs;
    record.stats = call.ioc->stats;
}

void answer_ioc_reset_statistics(Call& call, hxa_ioctl_gen_t&) { call.ioc->stats = {}; }

void answer_power(Call&, hxa_ioctl_ioc_power_t& record)
{
    record.status = record.power <= HXA_PM_DS_D3 ? HXA_STATUS_OK : HXA_STATUS_EINVAL;
}

void answer_adapter_name(Call& call, hxa_ioctl_ioc_set_adapter_name_t& record)
{
    call.host.name_adapter(*call.ioc, get_text(record.name));
}

void answer_port_name(Call& call, hxa_ioctl_ioc_set_adapter_name_t& record) { call.ioc->port_name = get_text(record.name); }

constexpr auto power = [](auto& record) { return std::tie(record.power); };
constexpr auto name = [](auto& record) { return std::tie(record.name); };

// clang-format off
constexpr Row ioc_table[] = {
    ioc_row<answer_enable>(              "IOCMD_IOC_ENABLE"),
    ioc_row<answer_disable>(             "IOCMD_IOC_DISABLE"),
    ioc_row<answer_ioc_attributes>(      "IOCMD_IOC_GET_ATTR"),
    ioc_row<answer_info>(                "IOCMD_IOC_GET_INFO"),
    ioc_row<answer_ioc_statistics>(      "IOCMD_IOC_GET_STATS"),
    ioc_row<answer_ioc_reset_statistics>("IOCMD_IOC_RESET_STATS"),
    ioc_row<answer_power>(               "IOCMD_IOC_SET_POWER",        power),
    ioc_row<answer_adapter_name>(        "IOCMD_IOC_SET_ADAPTER_NAME", name),
    ioc_row<answer_port_name>(           "IOCMD_IOC_SET_PORT_NAME",    name),
};
// clang-format on

} // namespace

std::span<const Row> ioc_rows() { return ioc_table; }

} // namespace hxasim
