// Records of the diagnostic requests.
#pragma once

#include "hxal/records/header.h"

// Where a loopback test turns the frames round. A port that is not tested works in the normal mode.
typedef enum
{
    HXA_PPORT_OPMODE_NORMAL = 0,
    HXA_PPORT_OPMODE_LB_INT = 1,    // inside the chip
    HXA_PPORT_OPMODE_LB_SLW = 2,    // serial link wrap
    HXA_PPORT_OPMODE_LB_EXT = 4,    // behind the transceiver
    HXA_PPORT_OPMODE_LB_CBL = 8,    // in the cable
    HXA_PPORT_OPMODE_LB_NLINT = 32, // inside, without a link
} hxa_pport_opmode_t;

// IOCMD_DIAG_REGREAD.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint16_t rsvd;       //  6
    uint32_t off;        //  8  of the first register
    uint32_t nwords;     // 12
    int32_t inst_no;     // 16  0
    uint32_t rsvd1;      // 20
    uint64_t buf_ptr;    // 24  address of the sender's buffer, `nwords` 32-bit words
} hxa_ioctl_diag_regread_t;
static_assert(sizeof(hxa_ioctl_diag_regread_t) == 32, "hxa_ioctl_diag_regread_t");
static_assert(offsetof(hxa_ioctl_diag_regread_t, off) == 8, "hxa_ioctl_diag_regread_t");
static_assert(offsetof(hxa_ioctl_diag_regread_t, inst_no) == 16, "hxa_ioctl_diag_regread_t");
static_assert(offsetof(hxa_ioctl_diag_regread_t, buf_ptr) == 24, "hxa_ioctl_diag_regread_t");

// IOCMD_DIAG_REGWRITE.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint16_t rsvd;       //  6
    uint32_t off;        //  8  of the register
    uint32_t word;       // 12
    int32_t inst_no;     // 16  0
    uint32_t rsvd1;      // 20
} hxa_ioctl_diag_regwrite_t;
static_assert(sizeof(hxa_ioctl_diag_regwrite_t) == 24, "hxa_ioctl_diag_regwrite_t");
static_assert(offsetof(hxa_ioctl_diag_regwrite_t, word) == 12, "hxa_ioctl_diag_regwrite_t");

// IOCMD_DIAG_TEMP.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint16_t temp;       //  6
} hxa_ioctl_diag_get_temp_t;
static_assert(sizeof(hxa_ioctl_diag_get_temp_t) == 8, "hxa_ioctl_diag_get_temp_t");
static_assert(offsetof(hxa_ioctl_diag_get_temp_t, temp) == 6, "hxa_ioctl_diag_get_temp_t");

// What a memory test found.
typedef struct
{
    uint32_t status;      //  0  hxa_status_t
    uint32_t addr;        //  4  where it failed
    uint32_t exp;         //  8  expected there
    uint32_t act;         // 12  found there
    uint32_t err_status;  // 16  of the memory controller
    uint32_t err_status1; // 20
    uint32_t err_addr;    // 24
    uint8_t algo;         // 28  that found it: 1 walk01, 2 marchy, 8 movi, 16 tlapnpsf1t
    uint8_t rsv[3];       // 29
} hxa_diag_memtest_result_t;
static_assert(sizeof(hxa_diag_memtest_result_t) == 32, "hxa_diag_memtest_result_t");
static_assert(offsetof(hxa_diag_memtest_result_t, err_status) == 16, "hxa_diag_memtest_result_t");
static_assert(offsetof(hxa_diag_memtest_result_t, algo) == 28, "hxa_diag_memtest_result_t");

// Which memory test to run.
typedef struct
{
    uint8_t algo;    //  0  0: all of them
    uint8_t rsvd[7]; //  1
} hxa_diag_memtest_t;
static_assert(sizeof(hxa_diag_memtest_t) == 8, "hxa_diag_memtest_t");

// IOCMD_DIAG_MEMTEST.
typedef struct
{
    hxa_status_t status;              //  0
    uint16_t hxad_num;                //  4
    uint16_t rsvd[3];                 //  6
    uint32_t pat;                     // 12  pattern
    hxa_diag_memtest_result_t result; // 16
    hxa_diag_memtest_t memtest;       // 48
} hxa_ioctl_diag_memtest_t;
static_assert(sizeof(hxa_ioctl_diag_memtest_t) == 56, "hxa_ioctl_diag_memtest_t");
static_assert(offsetof(hxa_ioctl_diag_memtest_t, pat) == 12, "hxa_ioctl_diag_memtest_t");
static_assert(offsetof(hxa_ioctl_diag_memtest_t, result) == 16, "hxa_ioctl_diag_memtest_t");
static_assert(offsetof(hxa_ioctl_diag_memtest_t, memtest) == 48, "hxa_ioctl_diag_memtest_t");

// What became of the frames of a loopback test.
typedef struct
{
    uint32_t numtxmfrm; //  0  frames sent
    uint32_t numosffrm; //  4  frames outstanding
    uint32_t numrcvfrm; //  8  frames received
    uint32_t badfrminf; // 12  about the first bad one
    uint32_t badfrmnum; // 16  its number
    uint8_t status;     // 20  hxa_status_t
    uint8_t rsvd[3];    // 21
} hxa_diag_loopback_result_t;
static_assert(sizeof(hxa_diag_loopback_result_t) == 24, "hxa_diag_loopback_result_t");
static_assert(offsetof(hxa_diag_loopback_result_t, numrcvfrm) == 8, "hxa_diag_loopback_result_t");
static_assert(offsetof(hxa_diag_loopback_result_t, status) == 20, "hxa_diag_loopback_result_t");

// IOCMD_DIAG_LOOPBACK. `lpcnt` and `pat` have their most significant byte first.
typedef struct
{
    hxa_status_t status;               //  0
    uint16_t hxad_num;                 //  4
    uint16_t rsvd;                     //  6
    uint32_t opmode;                   //  8  hxa_pport_opmode_t
    uint32_t speed;                    // 12  hxa_pport_speed_t
    uint32_t lpcnt;                    // 16  frames to send
    uint32_t pat;                      // 20  their contents
    hxa_diag_loopback_result_t result; // 24
} hxa_ioctl_diag_loopback_t;
static_assert(sizeof(hxa_ioctl_diag_loopback_t) == 48, "hxa_ioctl_diag_loopback_t");
static_assert(offsetof(hxa_ioctl_diag_loopback_t, opmode) == 8, "hxa_ioctl_diag_loopback_t");
static_assert(offsetof(hxa_ioctl_diag_loopback_t, lpcnt) == 16, "hxa_ioctl_diag_loopback_t");
static_assert(offsetof(hxa_ioctl_diag_loopback_t, result) == 24, "hxa_ioctl_diag_loopback_t");

// IOCMD_DIAG_LL_LOOPBACK. `lpcnt` and `pat` are in the byte order of the host.
typedef struct
{
    hxa_status_t status;               //  0
    uint16_t hxad_num;                 //  4
    uint16_t rsvd;                     //  6
    uint32_t opmode;                   //  8  hxa_pport_opmode_t
    uint32_t lpcnt;                    // 12  frames to send
    uint32_t pat;                      // 16  their contents
    hxa_diag_loopback_result_t result; // 20
} hxa_ioctl_diag_ll_loopback_t;
static_assert(sizeof(hxa_ioctl_diag_ll_loopback_t) == 44, "hxa_ioctl_diag_ll_loopback_t");
static_assert(offsetof(hxa_ioctl_diag_ll_loopback_t, lpcnt) == 12, "hxa_ioctl_diag_ll_loopback_t");
static_assert(offsetof(hxa_ioctl_diag_ll_loopback_t, result) == 20, "hxa_ioctl_diag_ll_loopback_t");

// What came back from the firmware.
typedef struct
{
    uint32_t data[4];   //  0
    uint32_t status[4]; // 16
    uint32_t dmastatus; // 32
    uint8_t rsvd[4];    // 36
} hxa_diag_fwping_result_t;
static_assert(sizeof(hxa_diag_fwping_result_t) == 40, "hxa_diag_fwping_result_t");
static_assert(offsetof(hxa_diag_fwping_result_t, dmastatus) == 32, "hxa_diag_fwping_result_t");

// IOCMD_DIAG_FWPING.
typedef struct
{
    hxa_status_t status;             //  0
    uint16_t hxad_num;               //  4
    uint16_t rsvd;                   //  6
    uint32_t cnt;                    //  8  how many times
    uint32_t pattern;                // 12
    hxa_diag_fwping_result_t result; // 16
} hxa_ioctl_diag_fwping_t;
static_assert(sizeof(hxa_ioctl_diag_fwping_t) == 56, "hxa_ioctl_diag_fwping_t");
static_assert(offsetof(hxa_ioctl_diag_fwping_t, result) == 16, "hxa_ioctl_diag_fwping_t");

// What a queue test found.
typedef struct
{
    uint32_t status; //  0  hxa_status_t
    uint16_t count;  //  4
    uint8_t queue;   //  6
    uint8_t rsvd;    //  7
} hxa_diag_qtest_result_t;
static_assert(sizeof(hxa_diag_qtest_result_t) == 8, "hxa_diag_qtest_result_t");
static_assert(offsetof(hxa_diag_qtest_result_t, queue) == 6, "hxa_diag_qtest_result_t");

// IOCMD_DIAG_QUEUETEST.
typedef struct
{
    hxa_status_t status;            //  0
    uint16_t hxad_num;              //  4
    uint16_t rsvd;                  //  6
    uint32_t force;                 //  8  0
    uint32_t queue;                 // 12
    hxa_diag_qtest_result_t result; // 16
} hxa_ioctl_diag_qtest_t;
static_assert(sizeof(hxa_ioctl_diag_qtest_t) == 24, "hxa_ioctl_diag_qtest_t");
static_assert(offsetof(hxa_ioctl_diag_qtest_t, queue) == 12, "hxa_ioctl_diag_qtest_t");
static_assert(offsetof(hxa_ioctl_diag_qtest_t, result) == 16, "hxa_ioctl_diag_qtest_t");

// What the lights of a port shall do.
typedef struct
{
    uint32_t cmd;    //  0
    uint32_t color;  //  4
    uint16_t freq;   //  8
    uint8_t led;     // 10
    uint8_t rsvd[5]; // 11
} hxa_diag_ledtest_t;
static_assert(sizeof(hxa_diag_ledtest_t) == 16, "hxa_diag_ledtest_t");
static_assert(offsetof(hxa_diag_ledtest_t, freq) == 8, "hxa_diag_ledtest_t");
static_assert(offsetof(hxa_diag_ledtest_t, led) == 10, "hxa_diag_ledtest_t");

// IOCMD_DIAG_LED.
typedef struct
{
    hxa_status_t status;        //  0
    uint16_t hxad_num;          //  4
    uint16_t rsvd;              //  6
    hxa_diag_ledtest_t ledtest; //  8
} hxa_ioctl_diag_led_t;
static_assert(sizeof(hxa_ioctl_diag_led_t) == 24, "hxa_ioctl_diag_led_t");
static_assert(offsetof(hxa_ioctl_diag_led_t, ledtest) == 8, "hxa_ioctl_diag_led_t");

// IOCMD_DIAG_BEACON.
typedef struct
{
    hxa_status_t status;      //  0
    uint16_t hxad_num;        //  4
    uint16_t rsvd;            //  6
    uint32_t beacon;          //  8  hxa_boolean_t
    uint32_t link_e2e_beacon; // 12  hxa_boolean_t
    uint32_t second;          // 16  seconds until both go off by themselves; 0: never
} hxa_ioctl_diag_beacon_t;
static_assert(sizeof(hxa_ioctl_diag_beacon_t) == 20, "hxa_ioctl_diag_beacon_t");
static_assert(offsetof(hxa_ioctl_diag_beacon_t, link_e2e_beacon) == 12, "hxa_ioctl_diag_beacon_t");
static_assert(offsetof(hxa_ioctl_diag_beacon_t, second) == 16, "hxa_ioctl_diag_beacon_t");

// IOCMD_DIAG_LB_STAT. The status tells whether a loopback test holds the port.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint16_t rsvd;       //  6
} hxa_ioctl_diag_lb_stat_t;
static_assert(sizeof(hxa_ioctl_diag_lb_stat_t) == 8, "hxa_ioctl_diag_lb_stat_t");
