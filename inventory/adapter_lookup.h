// Look-ups by address and index. They read the adapters' lists in memory and send requests only where it is said.
//
// An adapter index counts from 1; IOC handles belong to the access library.
#pragma once

#include "hxal/hxal.h"
#include "runtime/string.h"

namespace zmlr::ProviderUtil
{

// The adapter with this address (a port's or node's WWN, or a MAC address); -1 when there is none.
int getAdapterIdByNWWN(const String& wwn);
int getAdapterIdByMacAddr(const String& mac);
int getAdapterId(const String& address);

// The adapter's address: of a CNA its MAC address (see read_cna_mac), else its node WWN; empty when port 0 has no IOC to
// take it from.
String getAddrByAdapterId(int adapter);

// The first Ethernet IOC, failing that FC IOC, of the adapter's lowest port that has one; null when there is none.
hxal_t* getHxalHandlerByAdapterId(int adapter);

// The FC IOC with this port WWN (is_wwn) or the Ethernet IOC with this MAC address; null when there is none.
hxal_t* getHxalHandlerByPortAddress(const String& address, bool is_wwn);
hxal_t* getHxalHandlerByPortWWN(const String& wwn);
hxal_t* getHxalHandlerByPortMAC(const String& mac);

// True when the FC IOC has this port WWN, the Ethernet IOC this MAC address, as the scan found them.
bool has_wwn(const hxal_t* fc, const String& address);
bool has_mac(const hxal_t* ethernet, const String& address);

// The host's network interface of the IOC with this MAC address; empty when there is none.
String getEthDeviceNameByMAC(const String& mac);

// The version of the first adapter's driver that tells one (one request for each IOC asked); empty when none does.
String getDriverVersion();

} // namespace zmlr::ProviderUtil
