// The adapters of the product line, and what a scenario need not say about them.
#pragma once

#include "sim/model/adapter.h"

#include <string_view>

namespace hxasim
{

struct Product
{
    Adapter_Kind kind;
    std::string_view model;
    std::string_view description;
    std::uint8_t speed; // Gbit/s
    std::uint16_t device_id;
};

// The product of that name; the usual one of the kind when the name is another's or empty.
const Product& product_of(Adapter_Kind kind, std::string_view model);

// Everything of adapter number `index` (0-based) of a host that can be derived, without ports.
Adapter usual_adapter(const Product& product, std::size_t index);

// Port `number` of that adapter: link up at full speed. `eth_number` counts the Ethernet ports of the host.
Port usual_port(const Adapter& adapter, std::size_t adapter_index, std::size_t number, std::size_t eth_number);

// Vital product data with the given field-replaceable unit number: an identifier text, the read-only keywords and their
// checksum, as in the PCI Local Bus 3.0, appendix I.
std::vector<std::uint8_t> build_vpd(const Adapter& adapter, std::string_view fru_number);

} // namespace hxasim
