// _sfpInfo: what a pluggable module tells about itself, out of its memory as SFF-8472 defines it.
#pragma once

#include "hxal/records/sfp.h"
#include "runtime/string.h"

namespace zmlr
{

// Texts are zero-terminated, and as the module delivered them: property_text() makes properties of them.
struct _sfpInfo
{
    char vendor_name[18] = {};
    char part_number[18] = {};
    char serial_number[18] = {};
    char tag[32] = {};   // "<serial number>_<adapter>_<port>"
    char kind[8] = {};   // "GBIC", "SFP" or "Unknown"
    char media[32] = {}; // what it is made for; a longer text is cut
    char revision[6] = {};
};
static_assert(sizeof(_sfpInfo) == 132);

// The record of the module in a port. `adapter` counts from 1, `port` from 0.
_sfpInfo sfp_info(const sfp_mem_t& memory, bool is_cna, int adapter, int port);

// The 10 Gigabit Ethernet media that the module complies with, without separator: "10G_BASE-SR".
String ethernet_media(const sfp_mem_t& memory);

// The Fibre Channel speeds that it complies with, in MB/s: "200,400,800".
String fc_media(const sfp_mem_t& memory);

} // namespace zmlr
