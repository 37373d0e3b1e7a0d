// Reading one adapter: the requests that fill an _hbaInfo.
#pragma once

#include "inventory/adapter_walk.h"
#include "inventory/hba_info.h"
#include "inventory/inventory_request.h"

#include <optional>

namespace zmlr
{

struct Ioc_Attributes
{
    hxa_ioc_attr_t value = {};
    bool are_read = false;
};

struct Hba_Reading
{
    Open_Port port; // port 0; an IOC whose attributes could not be read is closed
    Ioc_Attributes ethernet = {};
    Ioc_Attributes fc = {};
    _hbaInfo info = {}; // but for the adapter's state
};

// Reads the attributes of the IOCs of the adapter's port 0 (one request each, and one for a CNA's MAC address). Empty, with log
// lines that say why, when no IOC's attributes can be read.
std::optional<Hba_Reading> read_hba(const Open_Adapter& adapter, Open_Port port, const Inventory_Request& request);

// The MAC address that keys a CNA: its FC IOC's, as the driver knows it now, else as the scan found it. Without an FC IOC (its
// driver is not there) it is the Ethernet IOC's, so that two such adapters never share a key. Either may be null, not both.
mac_t read_cna_mac(const hxal_t* fc, const hxal_t* ethernet);

} // namespace zmlr
