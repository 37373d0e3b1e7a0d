// Values of the flash partitions of a card.
#pragma once

#include "hxal/records/header.h"

typedef enum
{
    HXA_FLASH_PART_OPTROM = 1,
    HXA_FLASH_PART_FWIMG = 2,
    HXA_FLASH_PART_FWCFG = 3,
    HXA_FLASH_PART_DRV = 4,
    HXA_FLASH_PART_BOOT = 5,
    HXA_FLASH_PART_ASIC = 6,
    HXA_FLASH_PART_MFG = 7,
    HXA_FLASH_PART_OPTROM2 = 8,
    HXA_FLASH_PART_VPD = 9,
    HXA_FLASH_PART_PBC = 10,     // pre-boot configuration
    HXA_FLASH_PART_BOOTOVL = 11, // boot overlay
} hxa_flash_part_type_t;

typedef enum
{
    HXA_FLASH_STATUS_GOOD = 0,
    HXA_FLASH_STATUS_NOT_PRESENT = 1,
    HXA_FLASH_STATUS_UNINIT = 2,
    HXA_FLASH_STATUS_BAD = 3,
    HXA_FLASH_STATUS_EMPTY = 4,
    HXA_FLASH_STATUS_CKFAIL = 5,
} hxa_flash_status_t;
