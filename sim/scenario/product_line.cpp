#include "sim/scenario/product_line.h"

#include "hxal/records/ioc.h"
#include "hxal/records/port.h"

#include <algorithm>
#include <array>
#include <cstdio>
#include <numeric>

namespace hxasim
{

namespace
{

using enum Adapter_Kind;

// The usual product of a kind stands first.
// clang-format off
constexpr std::array products{
    Product{fc_hba,    "Zemlar-F86", "Zemlar-F86 8 Gbit/s Fibre Channel HBA",                 8,  0x13},
    Product{fc_hba,    "Zemlar-F85", "Zemlar-F85 8 Gbit/s Fibre Channel HBA",                 8,  0x17},
    Product{fc_hba,    "Zemlar-F25", "Zemlar-F25 4 Gbit/s Fibre Channel HBA",                 4,  0x13},
    Product{fc_hba,    "Zemlar-F15", "Zemlar-F15 4 Gbit/s Fibre Channel HBA",                 4,  0x17},
    Product{cna,       "Zemlar-C20", "Zemlar-C20 10 Gbit/s Converged Network Adapter",        10, 0x14},
    Product{cna,       "Zemlar-C10", "Zemlar-C10 10 Gbit/s Converged Network Adapter",        10, 0x14},
    Product{mezzanine, "Zemlar-C07", "Zemlar-C07 10 Gbit/s Mezzanine Converged Network Adapter", 10, 0x21},
};
// clang-format on

template <typename... Values> std::string formatted(const char* format, Values... values)
{
    std::array<char, 64> text{};
    std::snprintf(text.data(), text.size(), format, values...);
    return text.data();
}

// An address: the given head, then a number of three bytes that is unique for a port and a purpose.
template <std::size_t size>
std::array<std::uint8_t, size> numbered(std::array<std::uint8_t, size> address, std::size_t adapter, std::size_t port)
{
    address[size - 2] = static_cast<std::uint8_t>(adapter);
    address[size - 1] = static_cast<std::uint8_t>(port);
    return address;
}

constexpr char serial_letter(Adapter_Kind kind) { return "FCM"[static_cast<std::size_t>(kind)]; }

void append(std::vector<std::uint8_t>& bytes, std::string_view text) { bytes.insert(bytes.end(), text.begin(), text.end()); }

void append_keyword(std::vector<std::uint8_t>& bytes, std::string_view keyword, std::string_view value)
{
    append(bytes, keyword);
    bytes.push_back(static_cast<std::uint8_t>(value.size()));
    append(bytes, value);
}

std::string padded(std::string_view text, std::size_t size)
{
    std::string result(text.substr(0, size));
    result.resize(size, ' ');
    return result;
}

} // namespace

const Product& product_of(Adapter_Kind kind, std::string_view model)
{
    auto same_kind = [&](const Product& product) { return product.kind == kind; };
    auto named = std::find_if(products.begin(), products.end(),
                              [&](const Product& product) { return same_kind(product) && product.model == model; });
    return named != products.end() ? *named : *std::find_if(products.begin(), products.end(), same_kind);
}

Adapter usual_adapter(const Product& product, std::size_t index)
{
    Adapter adapter;
    adapter.kind = product.kind;
    adapter.serial = formatted("ZM%c%07zu", serial_letter(product.kind), index + 1);
    adapter.name = formatted("adapter-%zu", index + 1);
    adapter.model = product.model;
    adapter.model_descr = product.description;
    adapter.manufacturer = "Zemlar";
    adapter.hwpath = formatted("0000:%02zx:00", index + 4);
    adapter.hw_version = "rev C";
    adapter.firmware_version = "2.1.3.0";
    adapter.fc_driver_version = "2.2.0.4";
    adapter.eth_driver_version = "2.2.0.9";
    adapter.bios_version = "2.1.2.8";
    adapter.efi_version = "2.1.2.6";
    adapter.fcode_version = "2.1.2.4";
    adapter.os_type = "Linux";
    adapter.device_id = product.device_id;
    adapter.max_speed = product.speed;
    adapter.cna_capable = adapter.converged();
    adapter.is_mezz = product.kind == mezzanine;
    return adapter;
}

Port usual_port(const Adapter& adapter, std::size_t adapter_index, std::size_t number, std::size_t eth_number)
{
    Port port;
    port.name = formatted("adapter-%zu-port-%zu", adapter_index + 1, number);
    port.symbolic_name = formatted("%.16s port %zu", adapter.model.c_str(), number);
    port.pwwn = numbered(Wwn{0x10, 0, 0, 0x05, 0x1E, 0x10, 0, 0}, adapter_index, number);
    port.nwwn = numbered(Wwn{0x20, 0, 0, 0x05, 0x1E, 0x10, 0, 0}, adapter_index, number);
    if (adapter.converged())
    {
        port.eth_name = formatted("eth%zu", eth_number);
        port.mac = numbered(Mac{0x00, 0x05, 0x1E, 0x20, 0, 0}, adapter_index, number);
        port.fcoe_mac = numbered(Mac{0x00, 0x05, 0x1E, 0x30, 0, 0}, adapter_index, number);
    }
    port.state = HXA_PPORT_ST_LINKUP;
    port.speed_supported = adapter.max_speed;
    port.type = HXA_PPORT_TYPE_NPORT;
    port.topology = HXA_PPORT_TOPOLOGY_P2P;
    port.base_port.address = 0x010000 + static_cast<std::uint32_t>((adapter_index * 8 + number) << 8);
    port.ioc_state = HXA_IOC_OPERATIONAL;
    port.eth_ioc_state = HXA_IOC_OPERATIONAL;
    return port;
}

std::vector<std::uint8_t> build_vpd(const Adapter& adapter, std::string_view fru_number)
{
    constexpr std::size_t identifier_size = 128; // puts the read-only section at byte 131
    constexpr std::size_t section_start = 134;

    std::vector<std::uint8_t> data{0x82, identifier_size, 0};
    append(data, padded(adapter.model_descr, identifier_size));
    data.insert(data.end(), {0x90, 0, 0});
    append_keyword(data, "V0", padded("ZEMLAR", 16));
    append_keyword(data, "V1", padded("FRU NUMBER", 19) + std::string(fru_number));
    append_keyword(data, "PN", adapter.model);
    append_keyword(data, "SN", adapter.serial);
    append(data, "RV");
    data.push_back(1);
    data.push_back(0); // the checksum
    auto section_size = data.size() - section_start;
    data[132] = static_cast<std::uint8_t>(section_size);
    data[133] = static_cast<std::uint8_t>(section_size >> 8);
    data.back() = static_cast<std::uint8_t>(0 - std::accumulate(data.begin(), data.end(), 0));
    data.push_back(0x78);
    return data;
}

} // namespace hxasim
