// The pluggable transceiver (SFP) of a port: its memory as SFF-8472 defines it, and the requests about it.
#pragma once

#include "hxal/records/header.h"

enum hxa_defs_sfp_media_t
#ifdef __cplusplus
    : uint32_t // whatever number a driver answers is a value of this type
#endif
{
    HXA_SFP_MEDIA_UNKNOWN = 0,
    HXA_SFP_MEDIA_CU = 1, // copper
    HXA_SFP_MEDIA_LW = 2, // long wave
    HXA_SFP_MEDIA_SW = 3, // short wave
    HXA_SFP_MEDIA_EL = 4, // electrical
    HXA_SFP_MEDIA_UNSUPPORT = 5,
};
typedef enum hxa_defs_sfp_media_t hxa_defs_sfp_media_t;
static_assert(sizeof(hxa_defs_sfp_media_t) == 4, "hxa_defs_sfp_media_t");

// How well the module is, by its own monitoring.
typedef enum
{
    HXA_POM_HEALTH_NOINFO = 1,
    HXA_POM_HEALTH_NORMAL = 2,
    HXA_POM_HEALTH_WARNING = 3,
    HXA_POM_HEALTH_ALARM = 4,
} hxa_pom_health_t;

// In the memory of a module texts are padded with blanks, without a terminator, and numbers of several bytes have their most
// significant byte first. Offsets are those of the record; a page of the module begins at each of 0 (address A0h) and 96 (A2h).

// Serial ID, base fields: A0h 0 to 63.
typedef struct
{
    uint8_t identifier;      //  0  1 GBIC, 2 soldered down, 3 SFP
    uint8_t ext_identifier;  //  1
    uint8_t connector;       //  2  7: LC
    uint8_t xcvr[8];         //  3  compliance, a bit each: [0] 10 Gbit/s Ethernet, [7] Fibre Channel speeds
    uint8_t encoding;        // 11  1: 8B/10B, 6: 64B/66B
    uint8_t br_norm;         // 12  nominal rate, 100 MBd
    uint8_t rate_id;         // 13
    uint8_t len_km;          // 14  reach: single mode fibre, km
    uint8_t len_100m;        // 15         single mode fibre, 100 m
    uint8_t len_om2;         // 16         50 um OM2 fibre, 10 m
    uint8_t len_om1;         // 17         62.5 um OM1 fibre, 10 m
    uint8_t len_cu;          // 18         copper, m
    uint8_t len_om3;         // 19         50 um OM3 fibre, 10 m
    uint8_t vendor_name[16]; // 20
    uint8_t unalloc1;        // 36
    uint8_t vendor_oui[3];   // 37
    uint8_t vendor_pn[16];   // 40  part number
    uint8_t vendor_rev[4];   // 56
    uint8_t wavelen[2];      // 60  nm
    uint8_t unalloc2;        // 62
    uint8_t cc_base;         // 63  low byte of the sum of 0 to 62
} sfp_serial_id_base_t;
static_assert(sizeof(sfp_serial_id_base_t) == 64, "sfp_serial_id_base_t");
static_assert(offsetof(sfp_serial_id_base_t, xcvr) == 3, "sfp_serial_id_base_t");
static_assert(offsetof(sfp_serial_id_base_t, br_norm) == 12, "sfp_serial_id_base_t");
static_assert(offsetof(sfp_serial_id_base_t, vendor_name) == 20, "sfp_serial_id_base_t");
static_assert(offsetof(sfp_serial_id_base_t, vendor_pn) == 40, "sfp_serial_id_base_t");
static_assert(offsetof(sfp_serial_id_base_t, wavelen) == 60, "sfp_serial_id_base_t");

// Serial ID, extended fields: A0h 64 to 95.
typedef struct
{
    uint8_t options[2];    //  0
    uint8_t br_max;        //  2  upper margin of the rate, %
    uint8_t br_min;        //  3  lower margin of the rate, %
    uint8_t vendor_sn[16]; //  4  serial number
    uint8_t date_code[8];  // 20  YYMMDD and two characters of the vendor's
    uint8_t diag_mon_type; // 28  how the module monitors itself
    uint8_t en_options;    // 29
    uint8_t sff_8472;      // 30  revision of the standard
    uint8_t cc_ext;        // 31  low byte of the sum of 0 to 30
} sfp_serial_id_ext_t;
static_assert(sizeof(sfp_serial_id_ext_t) == 32, "sfp_serial_id_ext_t");
static_assert(offsetof(sfp_serial_id_ext_t, vendor_sn) == 4, "sfp_serial_id_ext_t");
static_assert(offsetof(sfp_serial_id_ext_t, date_code) == 20, "sfp_serial_id_ext_t");
static_assert(offsetof(sfp_serial_id_ext_t, cc_ext) == 31, "sfp_serial_id_ext_t");

// When a monitored value is out of its range.
typedef struct
{
    uint8_t high_alarm[2];   //  0
    uint8_t low_alarm[2];    //  2
    uint8_t high_warning[2]; //  4
    uint8_t low_warning[2];  //  6
} sfp_thresholds_t;
static_assert(sizeof(sfp_thresholds_t) == 8, "sfp_thresholds_t");

// A straight line from what is measured to what it means.
typedef struct
{
    uint8_t slope[2];  //  0
    uint8_t offset[2]; //  2
} sfp_calibration_t;
static_assert(sizeof(sfp_calibration_t) == 4, "sfp_calibration_t");

// Diagnostics, base fields: A2h 0 to 95.
typedef struct
{
    sfp_thresholds_t temperature;      //  0  1/256 degree Celsius, signed
    sfp_thresholds_t voltage;          //  8  100 uV
    sfp_thresholds_t bias;             // 16  2 uA
    sfp_thresholds_t tx_power;         // 24  0.1 uW
    sfp_thresholds_t rx_power;         // 32  0.1 uW
    uint8_t rsvd[16];                  // 40
    uint8_t cal_rx_power[5][4];        // 56  coefficients of a polynomial, from the 4th power down to the constant
    sfp_calibration_t cal_bias;        // 76
    sfp_calibration_t cal_tx_power;    // 80
    sfp_calibration_t cal_temperature; // 84
    sfp_calibration_t cal_voltage;     // 88
    uint8_t rsvd2[3];                  // 92
    uint8_t cc_dmi;                    // 95  low byte of the sum of 0 to 94
} sfp_diag_base_t;
static_assert(sizeof(sfp_diag_base_t) == 96, "sfp_diag_base_t");
static_assert(offsetof(sfp_diag_base_t, rx_power) == 32, "sfp_diag_base_t");
static_assert(offsetof(sfp_diag_base_t, cal_rx_power) == 56, "sfp_diag_base_t");
static_assert(offsetof(sfp_diag_base_t, cal_bias) == 76, "sfp_diag_base_t");
static_assert(offsetof(sfp_diag_base_t, cal_voltage) == 88, "sfp_diag_base_t");
static_assert(offsetof(sfp_diag_base_t, cc_dmi) == 95, "sfp_diag_base_t");

// Diagnostics, extended fields: A2h 96 to 119. The values have the units of their thresholds.
typedef struct
{
    uint8_t temperature[2];   //  0
    uint8_t voltage[2];       //  2
    uint8_t bias[2];          //  4
    uint8_t tx_power[2];      //  6
    uint8_t rx_power[2];      //  8
    uint8_t rsvd[4];          // 10
    uint8_t status_ctrl;      // 14  bit 7: transmitter off, 2: transmitter fault, 1: no signal, 0: no values yet
    uint8_t rsvd2;            // 15
    uint8_t alarm_flags[2];   // 16  bits from 15: temperature, voltage, bias, tx_power, rx_power; high, then low
    uint8_t rsvd3[2];         // 18
    uint8_t warning_flags[2]; // 20  the same bits
    uint8_t ext_status[2];    // 22
} sfp_diag_ext_t;
static_assert(sizeof(sfp_diag_ext_t) == 24, "sfp_diag_ext_t");
static_assert(offsetof(sfp_diag_ext_t, rx_power) == 8, "sfp_diag_ext_t");
static_assert(offsetof(sfp_diag_ext_t, status_ctrl) == 14, "sfp_diag_ext_t");
static_assert(offsetof(sfp_diag_ext_t, alarm_flags) == 16, "sfp_diag_ext_t");
static_assert(offsetof(sfp_diag_ext_t, warning_flags) == 20, "sfp_diag_ext_t");

typedef struct
{
    sfp_serial_id_base_t serial_id_base; //   0
    sfp_serial_id_ext_t serial_id_ext;   //  64
    sfp_diag_base_t diag_base;           //  96
    sfp_diag_ext_t diag_ext;             // 192
} sfp_mem_t;
static_assert(sizeof(sfp_mem_t) == 216, "sfp_mem_t");
static_assert(offsetof(sfp_mem_t, serial_id_ext) == 64, "sfp_mem_t");
static_assert(offsetof(sfp_mem_t, diag_base) == 96, "sfp_mem_t");
static_assert(offsetof(sfp_mem_t, diag_ext) == 192, "sfp_mem_t");

// IOCMD_DIAG_SFP.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint16_t rsvd;       //  6
    sfp_mem_t sfp;       //  8
} hxa_ioctl_sfp_show_t;
static_assert(sizeof(hxa_ioctl_sfp_show_t) == 224, "hxa_ioctl_sfp_show_t");
static_assert(offsetof(hxa_ioctl_sfp_show_t, sfp) == 8, "hxa_ioctl_sfp_show_t");

// IOCMD_SFP_MEDIA.
typedef struct
{
    hxa_status_t status;        //  0
    uint16_t hxad_num;          //  4
    uint16_t rsvd;              //  6
    hxa_defs_sfp_media_t media; //  8
} hxa_ioctl_sfp_media_t;
static_assert(sizeof(hxa_ioctl_sfp_media_t) == 12, "hxa_ioctl_sfp_media_t");
static_assert(offsetof(hxa_ioctl_sfp_media_t, media) == 8, "hxa_ioctl_sfp_media_t");

// IOCMD_SFP_SPEED. The status tells whether the module supports the speed.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint16_t rsvd;       //  6
    uint32_t speed;      //  8  hxa_pport_speed_t
} hxa_ioctl_sfp_speed_t;
static_assert(sizeof(hxa_ioctl_sfp_speed_t) == 12, "hxa_ioctl_sfp_speed_t");
static_assert(offsetof(hxa_ioctl_sfp_speed_t, speed) == 8, "hxa_ioctl_sfp_speed_t");
