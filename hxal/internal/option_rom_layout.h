// The structures of an option ROM (PCI Firmware 3.0, Plug and Play BIOS 1.0A). All words are little-endian and stand at any
// address: take the offsets of the fields, and the bytes one by one.
#pragma once

#include <cstddef>
#include <cstdint>

namespace hxal
{

#pragma pack(push, 1)

// At the start of every image.
struct pci_optrom_hdr_t
{
    uint16_t sig;          //  0  0xAA55
    uint8_t len;           //  2
    uint8_t inivec[3];     //  3
    uint8_t vendor_sig[4]; //  6
    uint16_t bofmds;       // 10
    uint8_t rsvd[5];       // 12
    uint16_t ovltable;     // 17
    uint8_t cksum;         // 19
    uint16_t verlen;       // 20
    uint16_t verptr;       // 22
    uint16_t pcids;        // 24  offset of the PCI data structure, from the image
    uint16_t pnphdr;       // 26  offset of the Plug and Play header, from the image; 0: none
};
static_assert(sizeof(pci_optrom_hdr_t) == 28);
static_assert(offsetof(pci_optrom_hdr_t, pcids) == 24);

struct pci_3_0_ds_t
{
    uint32_t sig;        //  0
    uint16_t vendid;     //  4
    uint16_t devid;      //  6
    uint16_t devlistoff; //  8
    uint16_t len;        // 10
    uint8_t rev;         // 12
    uint8_t clcode[3];   // 13
    uint16_t imglen;     // 16  of the image, units of 512 bytes
    uint16_t coderev;    // 18
    uint8_t codetype;    // 20  0: x86
    uint8_t indr;        // 21  bit 7: the last image
    uint16_t mrtimglen;  // 22
    uint16_t cuoff;      // 24
    uint16_t dmtfclp;    // 26
};
static_assert(sizeof(pci_3_0_ds_t) == 28);
static_assert(offsetof(pci_3_0_ds_t, imglen) == 16);

struct pnp_hdr_t
{
    uint32_t signature;     //  0
    uint8_t rev;            //  4
    uint8_t len;            //  5  of the header, units of 16 bytes
    uint16_t off;           //  6
    uint8_t rsvd;           //  8
    uint8_t cksum;          //  9  makes the header add up to 0
    uint16_t pnp_dev_id[2]; // 10  the second one is the PCI device id
    uint16_t mfstr;         // 14
    uint16_t prstr;         // 16
    uint8_t devtype[3];     // 18
    uint8_t devind;         // 21
    uint16_t bcventr;       // 22
    uint16_t rsvd2;         // 24
    uint16_t sriv;          // 26
};
static_assert(sizeof(pnp_hdr_t) == 28);
static_assert(offsetof(pnp_hdr_t, pnp_dev_id[1]) == 12);

#pragma pack(pop)

} // namespace hxal
