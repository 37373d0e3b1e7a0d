// Reading one FC port: the request that fills an _hbaPortInfo.
#pragma once

#include "inventory/adapter_walk.h"
#include "inventory/hba_port_info.h"
#include "inventory/inventory_request.h"

#include <optional>

namespace zmlr
{

struct Port_Reading
{
    const Open_Adapter& adapter;
    const Open_Port& port; // with its FC IOC
    const Inventory_Request& request;
    hxa_pport_attr_t attributes = {};
    _hbaPortInfo info = {};
};

// Reads the attributes of a port (one request). Empty, with a log line, when that fails.
std::optional<Port_Reading> read_port(const Open_Adapter& adapter, const Open_Port& port, const Inventory_Request& request);

} // namespace zmlr
