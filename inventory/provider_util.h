// ProviderUtil: what every manager, helper and provider needs to know of the host, the driver and the adapters' addresses.
//
// Stateless: every function may be called from any thread, except while the access library scans. An address text is a
// WWN as 16 or a MAC address as 12 upper-case hexadecimal digits without separators; addresses are compared without regard
// to case. An adapter index counts from 1; IOC handles belong to the access library.
#pragma once

#include "hxal/hxal.h"
#include "inventory/class_id.h"
#include "runtime/string.h"

#include <cstddef>

namespace zmlr
{

// What getHostInfo has put into its buffer.
enum Host_Info : int
{
    HOST_IP_ADDRESS = 0, // an IPv4 address other than a loopback one, in dotted form
    HOST_NAME = 2,       // the bare host name
    HOST_LOCALHOST = 3,  // "localhost": the host has no usable name
    HOST_FULL_NAME = 4   // host name and domain name
};

class ProviderUtil
{
public:
    // The one object, for callers that hold their collaborators; no function needs it.
    static const ProviderUtil& getProviderUtil();

    // Room for an address text and its terminator.
    static constexpr std::size_t wwn_text_size = 17;
    static constexpr std::size_t mac_text_size = 13;

    // --- the host (host_info.cpp)

    // The node's name, "localhost" when it has none.
    static String getHostName();

    // Writes the text by which the host is known in the model, cut to `len` bytes with its terminator.
    static Host_Info getHostInfo(char* buf, int len);

    // "//" host "/root/zemlar:" path.
    static String updateNamespacePath(const String& path);

    static bool IsFileExist(const char* path);

    // --- address texts (address_text.cpp)

    // Write the text of an address to `out` (wwn_text_size or mac_text_size bytes). The bytes of a WWN count in memory order.
    static void WWN2str(char* out, const wwn_t* wwn);
    static void MAC2str(char* out, const mac_t* mac);

    // Read 16 (12) hexadecimal digits into the 8 (6) bytes at `out`; false, and zero bytes, when the text does not begin with
    // that many.
    static bool getRawWWNFromStr(const char* text, unsigned char* out);
    static bool getRawMacFromStr(const char* text, unsigned char* out);

    // The adapter's address in a ZEMLAR_PhysicalPackage tag, by the adapter's model; empty for a model that is not known.
    static String getNodeMACOrWWNFromTag(const String& tag, const String& model);

    // Copies a text without leading and trailing blanks; `out` has as much room as `in` takes.
    static void trimString(const char* in, char* out);

    // --- class names and the driver (provider_util.cpp)

    // The class's name, "INVALID CLASS" above MAXCLASSID.
    static String getClassName(classId_t id);

    // The gate: whether classes that need the adapters may be served at all.
    static bool getDriverStatus();

    // The version of the first adapter's driver that tells one (one request for each IOC asked); empty when none does.
    static String getDriverVersion();

    // --- look-ups (adapter_lookup.cpp)

    // The adapter with this address (a port's or node's WWN, or a MAC address); -1 when there is none.
    static int getAdapterIdByNWWN(const String& wwn);
    static int getAdapterIdByMacAddr(const String& mac);
    static int getAdapterId(const String& address);

    // The adapter's address: of a CNA its MAC address (see read_cna_mac), else its node WWN; empty when port 0 has no IOC to
    // take it from.
    static String getAddrByAdapterId(int adapter);

    // The first Ethernet IOC, failing that FC IOC, of the adapter's lowest port that has one; null when there is none.
    static hxal_t* getHxalHandlerByAdapterId(int adapter);

    // The FC IOC with this port WWN (is_wwn) or the Ethernet IOC with this MAC address; null when there is none.
    static hxal_t* getHxalHandlerByPortAddress(const String& address, bool is_wwn);
    static hxal_t* getHxalHandlerByPortWWN(const String& wwn) { return getHxalHandlerByPortAddress(wwn, true); }
    static hxal_t* getHxalHandlerByPortMAC(const String& mac) { return getHxalHandlerByPortAddress(mac, false); }

    // The host's network interface of the IOC with this MAC address; empty when there is none.
    static String getEthDeviceNameByMAC(const String& mac);

private:
    ProviderUtil() = default;
};

} // namespace zmlr
