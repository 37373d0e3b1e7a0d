// The description of a boot code archive: which image is what, and for which cards.
#pragma once

#include "hxal/internal/image.h"

#include <string_view>

namespace hxal
{

// What an image is; the value of every written one is also the type of its flash partition.
enum Image_Type
{
    image_ignored = 0,
    image_option_rom = 1,
    image_firmware = 2,
    image_firmware_configuration = 3,
    image_boot_overlay = 11,
};

// One image of an archive.
struct HXAL_IMAGE_DATA_T
{
    Image_Type itype = image_ignored;
    std::vector<uint16_t> idevice; // PCI device ids that it is for
    std::vector<uint8_t> iport;    // instances of the partition
    Image ibuf;                    // the image itself

    bool is_for(uint16_t devid) const;
};

// Reads a description, as boot.h has it; the images come without their bytes. HXA_STATUS_FAILED when no line has "IMAGE", when
// a TYPE, ID or PORT line stands outside an image (a complete one is over) or twice in it, when one has no value that can be
// read, and when an image lacks its TYPE or ID. Throws std::bad_alloc.
hxa_status_t read_boot_description(std::string_view text, std::vector<HXAL_IMAGE_DATA_T>& images);

} // namespace hxal
