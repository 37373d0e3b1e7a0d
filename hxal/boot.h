// Boot code update: writing the images of a boot code archive to one adapter, or to every adapter of the host.
//
// The archive is a tar file in the "ustar" format (POSIX.1-1988) whose first member has "boot.txt" in its name and describes
// the images that follow it, or a tar file whose first member is such an archive:
//
//     IMAGE                         begins the description of the next image
//     TYPE = O                      O option ROM, F firmware, C firmware configuration, L boot overlay; others are ignored
//     PORT = 0, 1                   instances of the partition, hexadecimal; optional, 0 when it is missing
//     ID = 13, 17                   PCI device ids that the image is for, hexadecimal; with TYPE and ID it is complete
//
// A line is recognised by the word that it contains; other lines are remarks. Blanks in a value do not count.
#pragma once

#include "hxal/ioc.h"

#ifdef __cplusplus
extern "C"
{
#endif

    // Reads the whole archive, then writes the images that are for PCI device id `devid` (0x13, 0x14, 0x17 or 0x21; 0: the one
    // that the IOC reports) to their partitions, each verified by reading it back, and switches the option ROM of cards 0x13
    // and 0x17 on. With a handle it updates that IOC's card; without one every card, through its first IOC and with the id
    // that this reports, and tells on standard output how it goes. The first failure ends the update; images written before
    // it stay written. A card that no image is for does not end an update of every card.
    //     HXA_STATUS_INVALID_DEVID  not one of these ids; the file is not opened
    //     HXA_STATUS_FAILED         the file cannot be opened, holds no description, or one with an error in it
    //     HXA_STATUS_BAD_FILE       no regular file, no tar archive, or one that ends too early
    //     HXA_STATUS_ENOMEM         out of memory; images of more than 64 MiB together, or a description of more than 1 MiB
    //     HXA_STATUS_CREATE_FILE    the inner archive cannot be unpacked to "./zmlrtmpfile", which is gone afterwards
    //     HXA_STATUS_DEVID_MISSING  no image is for the card (of the last card, when every card is updated)
    //     else                      the status of the request that failed, or of hxal_flash_update_part()
    // Run one update at a time: two would write to one card.
    hxa_status_t hxal_boot_fwupdate(const hxal_t* ioc, const char* file, uint16_t devid);

#ifdef __cplusplus
}
#endif
