// Fitting an option ROM to the card that it is written to (PCI Firmware 3.0, Plug and Play BIOS 1.0A).
#pragma once

#include "hxal/internal/image.h"

namespace hxal
{

// Walks the chain of images in an option ROM and recomputes their checksums. For the device ids 0x14, 0x17 and 0x21 the id is
// written into each image's PCI data structure and, for x86 code, into its Plug and Play header; for another id the walk ends
// at the first image of x86 code. HXA_STATUS_FAILED when a structure lies outside the bytes, x86 code has no Plug and Play
// header, or an image has no length; what was changed by then stays changed.
hxa_status_t update_device_id_chksum(Image& rom, uint16_t devid);

// Reverses the byte order of every 32-bit word; bytes left over stay as they are.
void reverse_words(Image& image);

} // namespace hxal
