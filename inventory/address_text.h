// Addresses as texts: a WWN is 16, a MAC address 12 upper-case hexadecimal digits without separators. Texts are compared without
// regard to case.
#pragma once

#include "hxal/hxal.h"
#include "runtime/string.h"

#include <cstddef>
#include <span>

namespace zmlr::ProviderUtil
{

// Room for an address text and its terminator.
inline constexpr std::size_t wwn_text_size = 17;
inline constexpr std::size_t mac_text_size = 13;

// Write the text of an address to `out` (wwn_text_size or mac_text_size bytes). The bytes of a WWN count in memory order.
void WWN2str(char* out, const wwn_t* wwn);
void MAC2str(char* out, const mac_t* mac);

// The texts, and any bytes as upper-case hexadecimal digits with a terminator (two for each, and one more).
String wwn_text(wwn_t wwn);
String mac_text(const mac_t& mac);
void write_hex(char* out, std::span<const unsigned char> bytes);

// Read 16 (12) hexadecimal digits into the 8 (6) bytes at `out`; false, and zero bytes, when the text does not begin with
// that many.
bool getRawWWNFromStr(const char* text, unsigned char* out);
bool getRawMacFromStr(const char* text, unsigned char* out);

// The adapter's address in a ZEMLAR_PhysicalPackage tag, by the adapter's model; empty for a model that is not known.
String getNodeMACOrWWNFromTag(const String& tag, const String& model);

// Copies a text without leading and trailing blanks; `out` has as much room as `in` takes.
void trimString(const char* in, char* out);

// Copies the text of a field as copy_text() does, without leading and trailing blanks.
void copy_trimmed(char* out, std::size_t out_size, const char* field, std::size_t size);
template <std::size_t N, std::size_t M> void copy_trimmed(char (&out)[N], const char (&field)[M])
{
    copy_trimmed(out, N, field, M);
}
template <std::size_t N, std::size_t M> void copy_trimmed(char (&out)[N], const unsigned char (&field)[M])
{
    copy_trimmed(out, N, reinterpret_cast<const char*>(field), M);
}

} // namespace zmlr::ProviderUtil
