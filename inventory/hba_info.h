// _hbaInfo: what the driver tells about one adapter, and how it gets there from the attributes of the adapter's IOCs.
#pragma once

#include "hxal/hxal.h"
#include "runtime/types.h"

namespace zmlr
{

// All texts are zero-terminated, and as the driver delivered them: property_text() makes properties of them.
struct _hbaInfo
{
    char node_wwn[24] = {};
    char mac[24] = {};        // CNA only
    sint32 adapter_state = 0; // CIM OperationalStatus: 10 Stopped, 11 In Service; of a controller only
    char host[256] = {};
    char model[16] = {};
    char serial_number[64] = {};
    char manufacturer[16] = {};
    char fru_number[17] = {};
    char fc_driver_name[16] = {};
    char fc_driver_version[64] = {};
    char eth_driver_name[16] = {};
    char eth_driver_version[64] = {};
    char firmware_version[64] = {};
    char boot_code_version[64] = {}; // only when it was asked for
    bool is_cna = false;

    // The key by which the adapter's instances are matched: a CNA's MAC address, an FC HBA's node WWN.
    const char* address() const { return is_cna ? mac : node_wwn; }

    const char* display_name() const { return is_cna ? "Zemlar CNA" : "Zemlar FC HBA"; }
};

// Fill the driver of one side. The attributes of a side also tell about the card: those that come first do.
void fill_ethernet_driver(_hbaInfo& info, const hxa_ioc_attr_t& attributes);
void fill_fc_driver(_hbaInfo& info, const hxa_ioc_attr_t& attributes);
void fill_card(_hbaInfo& info, const hxa_ioc_attr_t& attributes);

// Fill what only the FC side tells.
void fill_fru_number(_hbaInfo& info, const hxa_ioc_attr_t& fc_attributes);
void fill_boot_code(_hbaInfo& info, const hxa_ioc_attr_t& fc_attributes);

} // namespace zmlr
