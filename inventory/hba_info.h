// _hbaInfo: what the driver tells about one adapter, read once per adapter and request.
#pragma once

#include "hxal/hxal.h"
#include "inventory/provider_util.h"
#include "runtime/types.h"

#include <memory>
#include <optional>

namespace zmlr
{

// All texts are zero-terminated, and as the driver delivered them: property_text() makes properties of them.
struct _hbaInfo
{
    char node_wwn[24] = {};
    char mac[24] = {};        // CNA only
    sint32 adapter_state = 0; // CIM OperationalStatus: 10 Stopped, 11 In Service
    char host[256] = {};
    char model[16] = {};
    char serial_number[64] = {};
    char manufacturer[16] = {};
    char fc_driver_name[16] = {};
    char fc_driver_version[64] = {};
    char eth_driver_name[16] = {};
    char eth_driver_version[64] = {};
    char firmware_version[64] = {};
    bool is_cna = false;

    // The key by which the adapter's instances are matched: a CNA's MAC address, an FC HBA's node WWN.
    const char* address() const { return is_cna ? mac : node_wwn; }
};

// An IOC that is closed at the end of its scope.
struct Ioc_Closer
{
    void operator()(hxal_t* ioc) const { hxal_ioc_close(ioc); }
};
using Ioc_Handle = std::unique_ptr<hxal_t, Ioc_Closer>;

// Reads the attributes of the adapter's IOCs on port 0 (one request each, and one for a CNA's MAC address) and fills the record
// but for host and adapter state. Empty, with log lines that say why, when the adapter has no port or no IOC whose attributes
// can be read.
std::optional<_hbaInfo> read_hba_info(int adapter);

// The MAC address that keys a CNA: its FC IOC's, as the driver knows it now, else as the scan found it. Without an FC IOC (its
// driver is not there) it is the Ethernet IOC's, so that two such adapters never share a key. Either may be null, not both.
mac_t read_cna_mac(const hxal_t* fc, const hxal_t* ethernet);

} // namespace zmlr
