// Records about one I/O controller: driver version, instances present, identity (info), attributes, counters, power state
// and names.
#pragma once

#include "hxal/records/header.h"

// IOC states.
typedef enum
{
    HXA_IOC_RESET = 1,
    HXA_IOC_SEMWAIT = 2,
    HXA_IOC_HWINIT = 3,
    HXA_IOC_GETATTR = 4,
    HXA_IOC_OPERATIONAL = 5,
    HXA_IOC_INITFAIL = 6,
    HXA_IOC_HBFAIL = 7,
    HXA_IOC_DISABLING = 8,
    HXA_IOC_DISABLED = 9,
    HXA_IOC_FWMISMATCH = 10,
} hxa_ioc_state_t;

// Power states.
typedef enum
{
    HXA_PM_DS_D0 = 0,
    HXA_PM_DS_D1 = 1,
    HXA_PM_DS_D2 = 2,
    HXA_PM_DS_D3 = 3,
} hxa_pm_ds_t;

// IOCMD_IOC_GET_VERSION. It has no common header.
typedef struct
{
    hxa_status_t status; //  0
    uint32_t version;    //  4
} hxa_ioctl_ioc_get_version_t;
static_assert(sizeof(hxa_ioctl_ioc_get_version_t) == 8, "hxa_ioctl_ioc_get_version_t");

// IOCMD_IOC_GET_INST. It has no common header. Bit i of byte i/8, least significant bit first, stands for instance i.
typedef struct
{
    uint32_t cnt;   //  0  number of instances
    uint32_t rsvd;  //  4
    uint8_t bm[32]; //  8  bitmap of the instances present
} hxa_ioctl_ioc_get_inst_t;
static_assert(sizeof(hxa_ioctl_ioc_get_inst_t) == 40, "hxa_ioctl_ioc_get_inst_t");
static_assert(offsetof(hxa_ioctl_ioc_get_inst_t, bm) == 8, "hxa_ioctl_ioc_get_inst_t");

// IOCMD_IOC_GET_INFO.
typedef struct
{
    hxa_status_t status;     //   0
    uint16_t hxad_num;       //   4
    uint16_t rsvd;           //   6
    char serialnum[64];      //   8  adapter serial number
    char hwpath[32];         //  72  hardware path of the IOC
    char adapter_hwpath[32]; // 104  hardware path of its card
    char guid[128];          // 136
    char name[64];           // 264  adapter name
    char port_name[64];      // 328
    char eth_name[64];       // 392  network interface of an Ethernet IOC
    wwn_t pwwn;              // 456
    wwn_t nwwn;              // 464
    wwn_t factorypwwn;       // 472
    wwn_t factorynwwn;       // 480
    mac_t mac;               // 488
    mac_t factory_mac;       // 494
    mac_t current_mac;       // 500
    uint16_t rsvd2;          // 506
    uint32_t ioc_type;       // 508  hxa_ioc_type_e
    uint16_t pvid;           // 512
    uint16_t rsvd1[3];       // 514
} hxa_ioctl_ioc_info_t;
static_assert(sizeof(hxa_ioctl_ioc_info_t) == 520, "hxa_ioctl_ioc_info_t");
static_assert(offsetof(hxa_ioctl_ioc_info_t, guid) == 136, "hxa_ioctl_ioc_info_t");
static_assert(offsetof(hxa_ioctl_ioc_info_t, pwwn) == 456, "hxa_ioctl_ioc_info_t");
static_assert(offsetof(hxa_ioctl_ioc_info_t, mac) == 488, "hxa_ioctl_ioc_info_t");
static_assert(offsetof(hxa_ioctl_ioc_info_t, ioc_type) == 508, "hxa_ioctl_ioc_info_t");

// Vital product data of the card: PCI resource tags in `data`.
typedef struct
{
    uint8_t version;    //  0
    uint8_t vpd_sig[3]; //  1
    uint8_t chksum;     //  4
    uint8_t vendor;     //  5
    uint8_t len;        //  6
    uint8_t rsv;        //  7
    uint8_t data[512];  //  8
} hxa_mfg_vpd_t;
static_assert(sizeof(hxa_mfg_vpd_t) == 520, "hxa_mfg_vpd_t");

// Attributes of the card.
typedef struct
{
    char manufacturer[8];    //    0
    char serial_num[12];     //    8
    uint32_t rsvd1;          //   20
    char model[16];          //   24
    char model_descr[128];   //   40
    wwn_t pwwn;              //  168
    char node_symname[256];  //  176
    char hw_ver[64];         //  432
    char fw_ver[64];         //  496
    char optrom_ver[64];     //  560
    char os_type[64];        //  624
    hxa_mfg_vpd_t vpd;       //  688
    mac_t mac;               // 1208
    uint8_t nports;          // 1214
    uint8_t max_speed;       // 1215
    uint8_t prototype;       // 1216
    char asic_rev;           // 1217
    uint8_t pcie_gen;        // 1218
    uint8_t pcie_lanes_orig; // 1219
    uint8_t pcie_lanes;      // 1220
    uint8_t cna_capable;     // 1221
    uint8_t is_mezz;         // 1222
    uint8_t rsvd2;           // 1223
} hxa_adapter_attr_t;
static_assert(sizeof(hxa_adapter_attr_t) == 1224, "hxa_adapter_attr_t");
static_assert(offsetof(hxa_adapter_attr_t, pwwn) == 168, "hxa_adapter_attr_t");
static_assert(offsetof(hxa_adapter_attr_t, vpd) == 688, "hxa_adapter_attr_t");
static_assert(offsetof(hxa_adapter_attr_t, mac) == 1208, "hxa_adapter_attr_t");
static_assert(offsetof(hxa_adapter_attr_t, is_mezz) == 1222, "hxa_adapter_attr_t");

// Attributes of the driver and of the code that runs on the card.
typedef struct
{
    char driver[16];     //   0
    char driver_ver[64]; //  16
    char fw_ver[64];     //  80
    char bios_ver[64];   // 144
    char efi_ver[64];    // 208
    char ob_ver[64];     // 272  Open Boot
} hxa_ioc_driver_attr_t;
static_assert(sizeof(hxa_ioc_driver_attr_t) == 336, "hxa_ioc_driver_attr_t");

// PCI identity of the IOC.
typedef struct
{
    uint16_t vendor_id; //  0
    uint16_t device_id; //  2
    uint16_t ssid;      //  4
    uint16_t ssvid;     //  6
    uint32_t pcifn;     //  8  PCI function number
    uint32_t rsvd;      // 12
    char chip_rev[8];   // 16
} hxa_ioc_pci_attr_t;
static_assert(sizeof(hxa_ioc_pci_attr_t) == 24, "hxa_ioc_pci_attr_t");

typedef struct
{
    uint32_t ioc_type;                 //    0  hxa_ioc_type_e
    uint32_t state;                    //    4  hxa_ioc_state_t
    hxa_adapter_attr_t adapter_attr;   //    8
    hxa_ioc_driver_attr_t driver_attr; // 1232
    hxa_ioc_pci_attr_t pci_attr;       // 1568
    uint8_t port_id;                   // 1592  port of the card that this IOC drives
    uint8_t rsvd[7];                   // 1593
} hxa_ioc_attr_t;
static_assert(sizeof(hxa_ioc_attr_t) == 1600, "hxa_ioc_attr_t");
static_assert(offsetof(hxa_ioc_attr_t, adapter_attr) == 8, "hxa_ioc_attr_t");
static_assert(offsetof(hxa_ioc_attr_t, driver_attr) == 1232, "hxa_ioc_attr_t");
static_assert(offsetof(hxa_ioc_attr_t, pci_attr) == 1568, "hxa_ioc_attr_t");
static_assert(offsetof(hxa_ioc_attr_t, port_id) == 1592, "hxa_ioc_attr_t");

// IOCMD_IOC_GET_ATTR.
typedef struct
{
    hxa_status_t status; //    0
    uint16_t hxad_num;   //    4
    uint16_t rsvd;       //    6
    hxa_ioc_attr_t attr; //    8
} hxa_ioctl_ioc_attr_t;
static_assert(sizeof(hxa_ioctl_ioc_attr_t) == 1608, "hxa_ioctl_ioc_attr_t");
static_assert(offsetof(hxa_ioctl_ioc_attr_t, attr) == 8, "hxa_ioctl_ioc_attr_t");

// What the firmware of an IOC counts.
typedef struct
{
    uint32_t hb_count;      //  0  heart beats
    uint32_t cfg_reqs;      //  4
    uint32_t enable_reqs;   //  8
    uint32_t disable_reqs;  // 12
    uint32_t stats_reqs;    // 16
    uint32_t clrstats_reqs; // 20
    uint32_t unknown_reqs;  // 24
    uint32_t ic_reqs;       // 28  interrupt coalescing
} hxa_fw_ioc_stats_t;
static_assert(sizeof(hxa_fw_ioc_stats_t) == 32, "hxa_fw_ioc_stats_t");

// What the driver of an IOC counts.
typedef struct
{
    uint32_t ioc_isrs;        //  0  interrupts
    uint32_t ioc_enables;     //  4
    uint32_t ioc_disables;    //  8
    uint32_t ioc_hbfails;     // 12
    uint32_t ioc_boots;       // 16
    uint32_t stats_tmos;      // 20
    uint32_t hb_count;        // 24
    uint32_t disable_reqs;    // 28
    uint32_t enable_reqs;     // 32
    uint32_t disable_replies; // 36
    uint32_t enable_replies;  // 40
} hxa_drv_ioc_stats_t;
static_assert(sizeof(hxa_drv_ioc_stats_t) == 44, "hxa_drv_ioc_stats_t");

typedef struct
{
    hxa_drv_ioc_stats_t drv_stats; //  0
    hxa_fw_ioc_stats_t fw_stats;   // 44
} hxa_ioc_stats_t;
static_assert(sizeof(hxa_ioc_stats_t) == 76, "hxa_ioc_stats_t");
static_assert(offsetof(hxa_ioc_stats_t, fw_stats) == 44, "hxa_ioc_stats_t");

// IOCMD_IOC_GET_STATS.
typedef struct
{
    hxa_status_t status;   //  0
    uint16_t hxad_num;     //  4
    uint16_t rsvd;         //  6
    hxa_ioc_stats_t stats; //  8
} hxa_ioctl_ioc_stats_t;
static_assert(sizeof(hxa_ioctl_ioc_stats_t) == 84, "hxa_ioctl_ioc_stats_t");
static_assert(offsetof(hxa_ioctl_ioc_stats_t, stats) == 8, "hxa_ioctl_ioc_stats_t");

// IOCMD_IOC_SET_POWER.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint16_t rsvd;       //  6
    uint32_t power;      //  8  hxa_pm_ds_t
    uint32_t rsvd1;      // 12
} hxa_ioctl_ioc_power_t;
static_assert(sizeof(hxa_ioctl_ioc_power_t) == 16, "hxa_ioctl_ioc_power_t");
static_assert(offsetof(hxa_ioctl_ioc_power_t, power) == 8, "hxa_ioctl_ioc_power_t");

// IOCMD_IOC_SET_ADAPTER_NAME and IOCMD_IOC_SET_PORT_NAME.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint16_t rsvd;       //  6
    char name[64];       //  8  a name of 64 characters has no terminator
} hxa_ioctl_ioc_set_adapter_name_t;
static_assert(sizeof(hxa_ioctl_ioc_set_adapter_name_t) == 72, "hxa_ioctl_ioc_set_adapter_name_t");
static_assert(offsetof(hxa_ioctl_ioc_set_adapter_name_t, name) == 8, "hxa_ioctl_ioc_set_adapter_name_t");
