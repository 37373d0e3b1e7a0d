#include "sim/scenario/scenario.h"

#include "sim/scenario/fault_scenario.h"
#include "sim/scenario/json.h"
#include "sim/scenario/port_scenario.h"
#include "sim/scenario/product_line.h"
#include "sim/scenario/scenario_words.h"

#include <bitset>

namespace hxasim
{

namespace
{

constexpr std::size_t max_ports = 8;
constexpr std::uint32_t max_partition_size = 64 * 1024 * 1024;

// The instance numbers of one node as they are given away.
class Instance_Numbers
{
public:
    explicit Instance_Numbers(Node node) : _node(node) {}

    std::uint32_t take(Json_Object& port, std::string_view key)
    {
        auto instance = port.number(key, max_instances - 1, _next);
        if (instance >= max_instances)
            refuse(port.place(), "more than " + std::to_string(max_instances) + " IOCs on " + path_of(_node));
        if (_taken[instance])
            refuse(port.place_of(key), "instance " + std::to_string(instance) + " of " + path_of(_node) + " is taken");
        _taken.set(instance);
        _next = instance + 1;
        return instance;
    }

private:
    Node _node;
    std::bitset<max_instances> _taken;
    std::uint32_t _next = 0;
};

class Scenario_Reader
{
public:
    Scenario read(Json_Object object);

private:
    void read_drivers(Json_Object& drivers);
    void read_adapter(Json_Object& object, Adapter_Kind kind, const std::optional<std::string>& model, std::size_t usual_ports);
    void read_vpd(Json_Object& object, Adapter& adapter);
    void read_port(Json_Object& object, Adapter& adapter);
    void read_addresses(Json_Object& object, Port& port, bool converged);
    void generate(Json_Object& object);

    Scenario _scenario;
    Instance_Numbers _fc_instances{Node::hxa};
    Instance_Numbers _eth_instances{Node::hxn};
    std::size_t _eth_ports = 0;
};

Driver read_driver(Json_Object object)
{
    Driver driver;
    driver.present = object.boolean("present", driver.present);
    driver.version = object.number("version", max_u32, driver.version);
    driver.version_status = object.number("version_status", max_u32, driver.version_status);
    driver.instance_count = object.number("instance_count", max_u32);
    object.done();
    return driver;
}

void Scenario_Reader::read_drivers(Json_Object& drivers)
{
    if (auto hxa = drivers.object("hxa"))
        _scenario.driver(Node::hxa) = read_driver(*hxa);
    if (auto hxn = drivers.object("hxn"))
        _scenario.driver(Node::hxn) = read_driver(*hxn);
    drivers.done();
}

// Longest texts are the sizes of their record fields.
void read_texts(Json_Object& object, Adapter& adapter)
{
    // clang-format off
    adapter.serial             = object.text("serial",              12, adapter.serial);
    adapter.name               = object.text("name",                64, adapter.name);
    adapter.model_descr        = object.text("model_descr",        128, adapter.model_descr);
    adapter.manufacturer       = object.text("manufacturer",         8, adapter.manufacturer);
    adapter.hwpath             = object.text("hwpath",              29, adapter.hwpath);
    adapter.hw_version         = object.text("hw_version",          64, adapter.hw_version);
    adapter.firmware_version   = object.text("firmware_version",    64, adapter.firmware_version);
    adapter.fc_driver_version  = object.text("fc_driver_version",   64, adapter.fc_driver_version);
    adapter.eth_driver_version = object.text("eth_driver_version",  64, adapter.eth_driver_version);
    adapter.bios_version       = object.text("bios_version",        64, adapter.bios_version);
    adapter.efi_version        = object.text("efi_version",         64, adapter.efi_version);
    adapter.fcode_version      = object.text("fcode_version",       64, adapter.fcode_version);
    adapter.os_type            = object.text("os_type",             64, adapter.os_type);
    // clang-format on
}

void Scenario_Reader::read_vpd(Json_Object& object, Adapter& adapter)
{
    if (auto vpd = object.object("vpd"))
    {
        adapter.vpd.version = static_cast<std::uint8_t>(vpd->number("version", 255, adapter.vpd.version));
        adapter.vpd.vendor = static_cast<std::uint8_t>(vpd->number("vendor", 255, adapter.vpd.vendor));
        adapter.vpd.data = vpd->bytes("data", sizeof(hxa_mfg_vpd_t::data));
        vpd->done();
        return;
    }
    auto usual_fru = "FRU-" + adapter.serial;
    adapter.vpd.data = build_vpd(adapter, object.text("fru_number", 16, usual_fru));
}

Flash_Partition read_partition(Json_Object object)
{
    Flash_Partition partition{.type = object.choice("type", flash_part_words, max_u32, 0),
                              .instance = object.number("instance", 255, 0),
                              .size = object.number("size", max_partition_size, 65536)};
    partition.data = object.bytes("data", partition.size);
    partition.status = object.choice("status", flash_status_words, max_u32,
                                     partition.data.empty() ? HXA_FLASH_STATUS_EMPTY : HXA_FLASH_STATUS_GOOD);
    object.done();
    return partition;
}

Flash read_flash(Json_Object& object, std::size_t ports)
{
    if (!object.has("flash"))
        return usual_flash(ports);
    Flash flash;
    for (auto& partition : object.objects("flash", HXA_FLASH_PART_MAX))
        flash.partitions.push_back(read_partition(partition));
    return flash;
}

Adapter_Kind read_kind(Json_Object& object) { return static_cast<Adapter_Kind>(object.word("kind", kind_words)); }

std::optional<std::string> read_model(Json_Object& object)
{
    return object.has("model") ? std::optional(object.text("model", 16, "")) : std::nullopt;
}

// The ports of the object; where it has none, as many as usual that say nothing.
std::vector<Json_Object> ports_of(Json_Object& object, std::size_t usual)
{
    if (object.has("ports"))
        return object.objects("ports", max_ports);
    std::vector<Json_Object> ports;
    while (ports.size() < usual)
        ports.push_back(Json_Object::empty(object.place_of("ports[" + std::to_string(ports.size()) + "]")));
    return ports;
}

void Scenario_Reader::read_adapter(Json_Object& object, Adapter_Kind kind, const std::optional<std::string>& model,
                                   std::size_t usual_ports)
{
    auto index = _scenario.adapters.size();
    auto adapter = usual_adapter(product_of(kind, model.value_or("")), index);
    adapter.model = model.value_or(adapter.model);
    read_texts(object, adapter);
    adapter.device_id = static_cast<std::uint16_t>(object.number("device_id", 0xFFFF, adapter.device_id));
    adapter.max_speed = static_cast<std::uint8_t>(object.number("max_speed", 255, adapter.max_speed));
    adapter.temperature = static_cast<std::uint16_t>(object.number("temperature", 0xFFFF, adapter.temperature));
    adapter.cna_capable = object.boolean("cna_capable", adapter.cna_capable);
    adapter.is_mezz = object.boolean("is_mezz", adapter.is_mezz);
    adapter.plugged = object.boolean("plugged", adapter.plugged);
    read_vpd(object, adapter);

    for (auto& port : ports_of(object, usual_ports))
        read_port(port, adapter);
    adapter.flash = read_flash(object, adapter.ports.size());
    adapter.flash.optrom_enabled = object.boolean("option_rom", adapter.flash.optrom_enabled);
    object.done();
    _scenario.adapters.push_back(std::move(adapter));
}

void Scenario_Reader::read_addresses(Json_Object& object, Port& port, bool converged)
{
    port.pwwn = object.address("pwwn", port.pwwn);
    port.nwwn = object.address("nwwn", port.nwwn);
    port.factory_pwwn = object.address("factory_pwwn", port.pwwn);
    port.factory_nwwn = object.address("factory_nwwn", port.nwwn);
    if (!converged)
        return;
    port.mac = object.address("mac", port.mac);
    port.factory_mac = object.address("factory_mac", port.mac);
    port.current_mac = object.address("current_mac", port.mac);
    port.fcoe_mac = object.address("fcoe_mac", port.fcoe_mac);
    port.fcoe_factory_mac = object.address("fcoe_factory_mac", port.fcoe_mac);
    port.eth_name = object.text("eth_name", 64, port.eth_name);
}

void Scenario_Reader::read_port(Json_Object& object, Adapter& adapter)
{
    auto number = adapter.ports.size();
    auto port = usual_port(adapter, _scenario.adapters.size(), number, _eth_ports);
    read_addresses(object, port, adapter.converged());
    port.name = object.text("name", 64, port.name);
    port.symbolic_name = object.text("symbolic_name", 256, port.symbolic_name);
    read_link(object, port, adapter.converged());
    read_counters(object, port, adapter.converged());
    read_fabric(object, port);
    read_sfp(object, port, adapter);
    port.ioc_state = object.choice("ioc_state", ioc_state_words, max_u32, port.ioc_state);
    port.ioc_settle = object.number("ioc_settle", 1000, port.ioc_settle);
    port.fc_instance = _fc_instances.take(object, "fc_instance");
    if (adapter.converged())
    {
        port.eth_ioc_state = object.choice("eth_ioc_state", ioc_state_words, max_u32, port.ioc_state);
        port.eth_instance = _eth_instances.take(object, "eth_instance");
        ++_eth_ports;
    }
    object.done();
    adapter.ports.push_back(std::move(port));
}

void Scenario_Reader::generate(Json_Object& object)
{
    auto count = object.number("adapters", max_instances, 1);
    auto ports = object.number("ports", max_ports, 2);
    const auto kind = read_kind(object);
    const auto model = read_model(object);
    object.done();
    for (std::uint32_t adapter = 0; adapter < count; ++adapter)
    {
        auto generated = Json_Object::empty(object.place_of("adapters[" + std::to_string(adapter) + "]"));
        read_adapter(generated, kind, model, ports);
    }
}

Scenario Scenario_Reader::read(Json_Object object)
{
    object.text("description", 4096, "");
    if (auto drivers = object.object("drivers"))
        read_drivers(*drivers);
    for (auto& adapter : object.objects("adapters", max_instances))
        read_adapter(adapter, read_kind(adapter), read_model(adapter), 2);
    if (auto generated = object.object("generate"))
        generate(*generated);
    for (auto& fault : object.objects("faults", 1000))
        _scenario.faults.push_back(read_fault(fault));
    object.done();
    return std::move(_scenario);
}

} // namespace

Scenario parse_scenario(const std::string& text)
{
    const Json_Document document(text);
    return Scenario_Reader().read(document.root(""));
}

} // namespace hxasim
