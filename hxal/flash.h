// The flash of a card: its partitions, its manufacturing block, its option ROM switch.
//
// All IOCs of a card share one flash. A partition is named by its type (hxa_flash_part_type_t) and an instance: 0, or the
// port for a partition that every port has. Requests go out under the flash group whatever the type of the IOC; a driver
// that serves no flash answers HXA_STATUS_ENOTTY. Every function returns a status as hxal.h describes it, and an image that
// is larger than 64 MiB, more than any card holds, is HXA_STATUS_ENOMEM without a request.
#pragma once

#include "hxal/ioc.h"
#include "hxal/records/flash.h"

#ifdef __cplusplus
extern "C"
{
#endif

    // One request: the partition list. The driver's `npart` may exceed the array.
    hxa_status_t hxal_flash_get_attr(const hxal_t* ioc, hxa_flash_attr_t* attr);

    // One request: erases a partition. It stays erased until an image is written to it.
    hxa_status_t hxal_flash_erase_part(const hxal_t* ioc, hxa_flash_part_type_t type, uint8_t instance);

    // One request: reads the first `size` bytes of a partition. With `bfile` false `dest` is a buffer of `size` bytes; with
    // `bfile` true it is the path of a file, which is created or replaced once the driver answered HXA_STATUS_OK:
    //     HXA_STATUS_EFOPEN  the file cannot be opened for writing
    //     HXA_STATUS_FAILED  the file cannot be written to its end
    hxa_status_t hxal_flash_read_part(const hxal_t* ioc, hxa_flash_part_type_t type, uint8_t instance, char* dest, uint32_t size,
                                      hxa_boolean_t bfile);

    // Two requests: writes an image to a partition, reads it back and compares. With `bfile` false the image is the `size`
    // bytes at `src`; with `bfile` true `src` is the path of a file, the image all of it, and `size` does not count.
    //     HXA_STATUS_FAILED         no such file, nothing to read in it, or the bytes read back differ
    //     HXA_STATUS_EFOPEN         the file cannot be opened
    //     HXA_STATUS_CHECKSUM_FAIL  the 32-bit words of a firmware image (HXA_FLASH_PART_FWIMG) do not cancel out; nothing
    //                               was sent
    hxa_status_t hxal_flash_update_part(const hxal_t* ioc, hxa_flash_part_type_t type, uint8_t instance, const unsigned char* src,
                                        hxa_boolean_t bfile, uint32_t size);

    // One request: writes the manufacturing block. Serial and part number are cut after 11 and 14 characters. The card types
    // are the model numbers of the product line:
    //     15 (Zemlar-F15)  25 (Zemlar-F25)  85 (Zemlar-F85)  86 (Zemlar-F86)     Fibre Channel host bus adapters
    //     10 (Zemlar-C10)  20 (Zemlar-C20)                                       converged network adapters
    //     7 (Zemlar-C07)   17 (Zemlar-C17)                                       converged mezzanine cards
    // Any other is HXA_STATUS_EINVAL, without a request.
    hxa_status_t hxal_flash_mfg_info(const hxal_t* ioc, const char* serial, const char* partnum, wwn_t wwn, mac_t mac,
                                     uint32_t card_type);

    // One request each: whether the host's firmware finds the card's option ROM at its next start.
    hxa_status_t hxal_flash_enable_optrom(const hxal_t* ioc);
    hxa_status_t hxal_flash_disable_optrom(const hxal_t* ioc);

#ifdef __cplusplus
}
#endif
