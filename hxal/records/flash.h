// Records about the flash of a card: its partitions and its manufacturing block.
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

// One partition.
typedef struct
{
    uint32_t part_type;     //  0  hxa_flash_part_type_t
    uint32_t part_instance; //  4
    uint32_t part_off;      //  8  in the flash, bytes
    uint32_t part_size;     // 12  bytes
    uint32_t part_len;      // 16  bytes in use
    uint32_t part_status;   // 20  hxa_flash_status_t
    char rsv[8];            // 24
} hxa_flash_part_attr_t;
static_assert(sizeof(hxa_flash_part_attr_t) == 32, "hxa_flash_part_attr_t");

#define HXA_FLASH_PART_MAX 16

typedef struct
{
    uint32_t status;                                //  0  hxa_flash_status_t
    uint32_t npart;                                 //  4  partitions in use
    hxa_flash_part_attr_t part[HXA_FLASH_PART_MAX]; //  8
} hxa_flash_attr_t;
static_assert(sizeof(hxa_flash_attr_t) == 520, "hxa_flash_attr_t");
static_assert(offsetof(hxa_flash_attr_t, part) == 8, "hxa_flash_attr_t");

// IOCMD_FLASH_GET_ATTR.
typedef struct
{
    hxa_status_t status;   //  0
    uint16_t hxad_num;     //  4
    uint16_t rsvd;         //  6
    hxa_flash_attr_t attr; //  8
} hxa_ioctl_flash_attr_t;
static_assert(sizeof(hxa_ioctl_flash_attr_t) == 528, "hxa_ioctl_flash_attr_t");
static_assert(offsetof(hxa_ioctl_flash_attr_t, attr) == 8, "hxa_ioctl_flash_attr_t");

// IOCMD_FLASH_ERASE_PART (without a buffer), IOCMD_FLASH_UPDATE_PART, IOCMD_FLASH_READ_PART.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint8_t instance;    //  6  of the partition
    uint8_t rsvd;        //  7
    uint64_t buf_ptr;    //  8  address of the data
    uint32_t type;       // 16  hxa_flash_part_type_t
    int32_t bufsz;       // 20  bytes at buf_ptr
} hxa_ioctl_flash_t;
static_assert(sizeof(hxa_ioctl_flash_t) == 24, "hxa_ioctl_flash_t");
static_assert(offsetof(hxa_ioctl_flash_t, instance) == 6, "hxa_ioctl_flash_t");
static_assert(offsetof(hxa_ioctl_flash_t, buf_ptr) == 8, "hxa_ioctl_flash_t");
static_assert(offsetof(hxa_ioctl_flash_t, type) == 16, "hxa_ioctl_flash_t");

// What the factory writes into a card.
typedef struct
{
    uint8_t version;             //   0
    uint8_t mfg_sig[3];          //   1
    uint16_t mfgsize;            //   4  bytes of the block
    uint16_t u16_chksum;         //   6
    char zmlr_serialnum[12];     //   8
    char zmlr_partnum[16];       //  20
    uint8_t mfg_day;             //  36
    uint8_t mfg_month;           //  37
    uint16_t mfg_year;           //  38
    wwn_t mfg_wwn;               //  40
    uint8_t num_wwn;             //  48
    uint8_t mfg_speeds;          //  49
    uint8_t rsv[2];              //  50
    char supplier_id[12];        //  52
    char supplier_partnum[24];   //  64
    char supplier_serialnum[24]; //  88
    char supplier_revision[8];   // 112
    mac_t mfg_mac;               // 120
    uint8_t num_mac;             // 126
    uint8_t rsv2;                // 127
    uint32_t mfg_type;           // 128  model number of the card
    uint8_t rsv3[108];           // 132
    uint8_t md5_chksum[16];      // 240
} hxa_mfg_block_t;
static_assert(sizeof(hxa_mfg_block_t) == 256, "hxa_mfg_block_t");
static_assert(offsetof(hxa_mfg_block_t, mfg_wwn) == 40, "hxa_mfg_block_t");
static_assert(offsetof(hxa_mfg_block_t, supplier_id) == 52, "hxa_mfg_block_t");
static_assert(offsetof(hxa_mfg_block_t, mfg_mac) == 120, "hxa_mfg_block_t");
static_assert(offsetof(hxa_mfg_block_t, mfg_type) == 128, "hxa_mfg_block_t");
static_assert(offsetof(hxa_mfg_block_t, md5_chksum) == 240, "hxa_mfg_block_t");

// IOCMD_FLASH_MFG_INFO.
typedef struct
{
    hxa_status_t status;       //  0
    uint16_t hxad_num;         //  4
    uint16_t rsvd;             //  6
    hxa_mfg_block_t mfg_block; //  8
} hxa_ioctl_flash_mfg_t;
static_assert(sizeof(hxa_ioctl_flash_mfg_t) == 264, "hxa_ioctl_flash_mfg_t");
static_assert(offsetof(hxa_ioctl_flash_mfg_t, mfg_block) == 8, "hxa_ioctl_flash_mfg_t");
