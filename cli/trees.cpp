#include "cli/trees.h"

#include "cli/field_text.h"
#include "hxal/ethport.h"
#include "hxal/port.h"
#include "hxal/value_names.h"

namespace hxa
{

namespace
{

const char* type_word(const hxal_t& ioc)
{
    switch (ioc.ioc_type)
    {
    case HXA_IOC_TYPE_FC:
        return "FC";
    case HXA_IOC_TYPE_FCoE:
        return "FCoE";
    default:
        return "Ethernet";
    }
}

void add(Object& object, Object more)
{
    for (auto& member : more)
        object.push_back(std::move(member));
}

Value ioc_tree(Session& session, const std::string& port, const hxal_t& ioc)
{
    Object tree{{"type", type_word(ioc)},
                {"instance", ioc.instance},
                {"device", ioc.devpath},
                {"hardware_path", field_text(ioc.ioc_hwpath)}};
    hxa_ioc_attr_t attr{};
    if (session.accept(hxal_ioc_get_attr(&ioc, &attr), "IOC of port " + port))
        add(tree, {{"state", hxal_ioc_state_to_string(attr.state)},
                   {"driver", field_text(attr.driver_attr.driver)},
                   {"driver_version", field_text(attr.driver_attr.driver_ver)},
                   {"pci_vendor", hexadecimal(attr.pci_attr.vendor_id, 4)},
                   {"pci_device", hexadecimal(attr.pci_attr.device_id, 4)},
                   {"pci_function", attr.pci_attr.pcifn}});
    return tree;
}

Value configuration_tree(const hxa_pport_cfg_t& configured)
{
    return Object{{"speed_gbps", speed_value(configured.speed)},
                  {"topology", hxal_pport_topology_to_string(configured.topology)},
                  {"max_frame_size_bytes", unsigned{configured.maxfrsize}},
                  {"hard_address", configured.cfg_hardalpa ? Value(hexadecimal(configured.hardalpa, 2)) : Value()},
                  {"trunked", configured.trunked != 0},
                  {"qos", configured.qos_enabled != 0},
                  {"rate_limit", configured.ratelimit != 0},
                  {"rate_limit_default_speed_gbps", speed_value(configured.trl_def_speed)},
                  {"receive_credits", unsigned{configured.rx_bbcredit}},
                  {"transmit_credits", unsigned{configured.tx_bbcredit}},
                  {"path_timeout_seconds", unsigned{configured.path_tov}},
                  {"queue_depth", unsigned{configured.q_depth}}};
}

Value fc_tree(Session& session, const std::string& name, const hxal_t& ioc)
{
    Object tree{{"wwn", wwn_text(ioc.pwwn)},
                {"node_wwn", wwn_text(ioc.nwwn)},
                {"factory_wwn", wwn_text(ioc.factorypwwn)},
                {"factory_node_wwn", wwn_text(ioc.factorynwwn)}};
    if (ioc.ioc_type == HXA_IOC_TYPE_FCoE)
        tree.push_back({"mac", mac_text(ioc.mac)});
    hxa_pport_attr_t attr{};
    if (session.accept(hxal_port_get_attr(&ioc, &attr), "port " + name))
        add(tree, {{"state", hxal_pport_states_to_string(attr.port_state)},
                   {"speed_gbps", speed_value(attr.speed)},
                   {"speed_supported_gbps", speed_value(attr.speed_supported)},
                   {"topology", hxal_pport_topology_to_string(attr.topology)},
                   {"port_type", hxal_pport_type_to_string(attr.port_type)},
                   {"address", attr.pid ? Value(address_text(attr.pid)) : Value()},
                   {"symbolic_name", field_text(attr.port_symname)},
                   {"beacon", attr.beacon != 0},
                   {"link_beacon", attr.link_e2e_beacon != 0},
                   {"persistent_binding", attr.pbind_enabled != 0},
                   {"configured", configuration_tree(attr.pport_cfg)}});
    tree.push_back({"ioc", ioc_tree(session, name, ioc)});
    return tree;
}

Value ethernet_tree(Session& session, const std::string& name, const hxal_t& ioc)
{
    Object tree{{"interface", field_text(ioc.eth_name)},
                {"mac", mac_text(ioc.mac)},
                {"factory_mac", mac_text(ioc.factory_mac)},
                {"current_mac", mac_text(ioc.current_mac)}};
    hxa_ethport_attr_t attr{};
    if (session.accept(hxal_ethport_get_attr(&ioc, &attr), "Ethernet port " + name))
        add(tree, {{"state", hxal_pport_states_to_string(attr.port_state)},
                   {"speed_gbps", speed_value(attr.speed)},
                   {"speed_supported_gbps", speed_value(attr.speed_supported)},
                   {"mtu_bytes", attr.mtu}});
    tree.push_back({"ioc", ioc_tree(session, name, ioc)});
    return tree;
}

} // namespace

Value speed_value(std::uint32_t speed)
{
    if (speed == HXA_PPORT_SPEED_UNKNOWN)
        return {};
    return speed == HXA_PPORT_SPEED_AUTO ? Value("auto") : Value(speed);
}

Value port_tree(Session& session, const Port& port)
{
    return Object{{"port", port.name()},
                  {"adapter", port.adapter.number},
                  {"number", port.number},
                  {"type", type_word(*port.ioc())},
                  {"name", field_text(port.ioc()->port_name)},
                  {"fc", port.fc ? fc_tree(session, port.name(), *port.fc) : Value()},
                  {"ethernet", port.ethernet ? ethernet_tree(session, port.name(), *port.ethernet) : Value()}};
}

Object adapter_tree(Session& session, const Adapter& adapter)
{
    Object tree{{"adapter", adapter.number},
                {"serial_number", field_text(adapter.handle->serial_num)},
                {"name", field_text(adapter.handle->name)},
                {"hardware_path", field_text(adapter.handle->adapter_hwpath)},
                {"converged", adapter.handle->cna_capable != HXA_FALSE}};
    hxa_ioc_attr_t attr{};
    if (session.accept(hxal_ioc_get_attr(adapter.ioc(), &attr), "adapter " + adapter.name()))
    {
        const auto& card = attr.adapter_attr;
        add(tree, {{"manufacturer", field_text(card.manufacturer)},
                   {"model", field_text(card.model)},
                   {"description", field_text(card.model_descr)},
                   {"hardware_version", field_text(card.hw_ver)},
                   {"firmware_version", field_text(card.fw_ver)},
                   {"option_rom_version", field_text(card.optrom_ver)},
                   {"bios_version", field_text(attr.driver_attr.bios_ver)},
                   {"efi_version", field_text(attr.driver_attr.efi_ver)},
                   {"open_boot_version", field_text(attr.driver_attr.ob_ver)},
                   {"max_speed_gbps", speed_value(card.max_speed)},
                   {"pcie_generation", unsigned{card.pcie_gen}},
                   {"pcie_lanes", unsigned{card.pcie_lanes}},
                   {"mezzanine", card.is_mezz != 0}});
    }
    return tree;
}

} // namespace hxa
