// Records about the remote ports that a logical port has discovered. A request names the logical port by its port WWN and
// virtual fabric, and the remote port by its port WWN.
#pragma once

#include "hxal/records/port.h"

typedef enum
{
    HXA_RPORT_UNINIT = 0,
    HXA_RPORT_OFFLINE = 1,
    HXA_RPORT_PLOGI = 2,
    HXA_RPORT_ONLINE = 3,
    HXA_RPORT_PLOGI_RETRY = 4,
    HXA_RPORT_NSQUERY = 5,
    HXA_RPORT_ADISC = 6,
    HXA_RPORT_LOGO = 7,
    HXA_RPORT_LOGORCV = 8,
    HXA_RPORT_NSDISC = 9,
} hxa_rport_state_t;

// What a remote port does, a bit each.
typedef enum
{
    HXA_RPORT_INITIATOR = 1,
    HXA_RPORT_TARGET = 2,
} hxa_rport_function_t;

typedef struct
{
    uint32_t qos_priority; //  0  hxa_qos_priority_t
    uint32_t qos_flow_id;  //  4
} hxa_rport_qos_attr_t;
static_assert(sizeof(hxa_rport_qos_attr_t) == 8, "hxa_rport_qos_attr_t");

typedef struct
{
    wwn_t nwwn;                    //   0
    wwn_t pwwn;                    //   8
    uint32_t cos_supported;        //  16  fc_cos_t
    uint32_t pid;                  //  20  FC address, bytes in wire order
    uint32_t df_sz;                //  24  data field of a frame, bytes
    uint32_t state;                //  28  hxa_rport_state_t
    uint32_t fc_cos;               //  32  fc_cos_t in use
    uint32_t cisc;                 //  36  hxa_boolean_t: continuously increasing sequence count
    char symname[255];             //  40  symbolic port name
    uint8_t rsvd;                  // 295
    uint32_t scsi_function;        // 296  hxa_rport_function_t
    hxa_rport_qos_attr_t qos_attr; // 300
    uint32_t curr_speed;           // 308  hxa_pport_speed_t
    uint32_t trl_enforced;         // 312  hxa_boolean_t: its rate is limited
    uint32_t assigned_speed;       // 316  hxa_pport_speed_t
} hxa_rport_attr_t;
static_assert(sizeof(hxa_rport_attr_t) == 320, "hxa_rport_attr_t");
static_assert(offsetof(hxa_rport_attr_t, df_sz) == 24, "hxa_rport_attr_t");
static_assert(offsetof(hxa_rport_attr_t, symname) == 40, "hxa_rport_attr_t");
static_assert(offsetof(hxa_rport_attr_t, scsi_function) == 296, "hxa_rport_attr_t");
static_assert(offsetof(hxa_rport_attr_t, qos_attr) == 300, "hxa_rport_attr_t");
static_assert(offsetof(hxa_rport_attr_t, assigned_speed) == 316, "hxa_rport_attr_t");

// IOCMD_RPORT_GET_ATTR.
typedef struct
{
    hxa_status_t status;   //  0
    uint16_t hxad_num;     //  4
    uint16_t vf_id;        //  6  virtual fabric
    wwn_t pwwn;            //  8  of the logical port
    wwn_t rpwwn;           // 16  of the remote port
    hxa_rport_attr_t attr; // 24
} hxa_ioctl_rport_attr_t;
static_assert(sizeof(hxa_ioctl_rport_attr_t) == 344, "hxa_ioctl_rport_attr_t");
static_assert(offsetof(hxa_ioctl_rport_attr_t, vf_id) == 6, "hxa_ioctl_rport_attr_t");
static_assert(offsetof(hxa_ioctl_rport_attr_t, pwwn) == 8, "hxa_ioctl_rport_attr_t");
static_assert(offsetof(hxa_ioctl_rport_attr_t, rpwwn) == 16, "hxa_ioctl_rport_attr_t");
static_assert(offsetof(hxa_ioctl_rport_attr_t, attr) == 24, "hxa_ioctl_rport_attr_t");

// How often a remote port went on and off line, and its link services (FC-LS) by their outcome.
typedef struct
{
    uint32_t offlines;       //   0
    uint32_t onlines;        //   4
    uint32_t rscns;          //   8
    uint32_t plogis;         //  12
    uint32_t plogi_accs;     //  16
    uint32_t plogi_timeouts; //  20
    uint32_t plogi_rejects;  //  24
    uint32_t plogi_failed;   //  28
    uint32_t plogi_rcvd;     //  32
    uint32_t prli_rcvd;      //  36
    uint32_t adisc_rcvd;     //  40
    uint32_t adisc_rejects;  //  44
    uint32_t adisc_sent;     //  48
    uint32_t adisc_accs;     //  52
    uint32_t adisc_failed;   //  56
    uint32_t adisc_rejected; //  60
    uint32_t logos;          //  64
    uint32_t logo_accs;      //  68
    uint32_t logo_failed;    //  72
    uint32_t logo_rejected;  //  76
    uint32_t logo_rcvd;      //  80
    uint32_t rpsc_rcvd;      //  84
    uint32_t rpsc_rejects;   //  88
    uint32_t rpsc_sent;      //  92
    uint32_t rpsc_accs;      //  96
    uint32_t rpsc_failed;    // 100
    uint32_t rpsc_rejected;  // 104
    uint32_t rsvd;           // 108
    uint32_t sm_un_cr;       // 112  state machine: first of its events
    uint32_t sm_events[35];  // 116  the others in the driver's order
    uint32_t sm_iocd_unexp;  // 256  the last
    uint32_t rsvd2;          // 260
} hxa_rport_stats_t;
static_assert(sizeof(hxa_rport_stats_t) == 264, "hxa_rport_stats_t");
static_assert(offsetof(hxa_rport_stats_t, plogi_rcvd) == 32, "hxa_rport_stats_t");
static_assert(offsetof(hxa_rport_stats_t, rsvd) == 108, "hxa_rport_stats_t");
static_assert(offsetof(hxa_rport_stats_t, sm_un_cr) == 112, "hxa_rport_stats_t");
static_assert(offsetof(hxa_rport_stats_t, sm_iocd_unexp) == 256, "hxa_rport_stats_t");

// IOCMD_RPORT_GET_STATS.
typedef struct
{
    hxa_status_t status;     //  0
    uint16_t hxad_num;       //  4
    uint16_t vf_id;          //  6  virtual fabric
    wwn_t pwwn;              //  8  of the logical port
    wwn_t rpwwn;             // 16  of the remote port
    hxa_rport_stats_t stats; // 24
} hxa_ioctl_rport_stats_t;
static_assert(sizeof(hxa_ioctl_rport_stats_t) == 288, "hxa_ioctl_rport_stats_t");
static_assert(offsetof(hxa_ioctl_rport_stats_t, stats) == 24, "hxa_ioctl_rport_stats_t");

// IOCMD_RPORT_ADD, IOCMD_RPORT_REMOVE and, under a name of its own, IOCMD_RPORT_RESET_STATS.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint16_t vf_id;      //  6  virtual fabric
    wwn_t pwwn;          //  8  of the logical port
    wwn_t rpwwn;         // 16  of the remote port
} hxa_ioctl_rport_t;
static_assert(sizeof(hxa_ioctl_rport_t) == 24, "hxa_ioctl_rport_t");
static_assert(offsetof(hxa_ioctl_rport_t, rpwwn) == 16, "hxa_ioctl_rport_t");
typedef hxa_ioctl_rport_t hxa_ioctl_rport_reset_stats_t;

// IOCMD_RPORT_GET_SCSI_ADDR: where the operating system shows the remote target.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint16_t vf_id;      //  6  virtual fabric
    wwn_t pwwn;          //  8  of the logical port
    wwn_t rpwwn;         // 16  of the remote port
    uint32_t host;       // 24
    uint32_t bus;        // 28
    uint32_t target;     // 32
    uint32_t lun;        // 36
} hxa_ioctl_rport_scsi_addr_t;
static_assert(sizeof(hxa_ioctl_rport_scsi_addr_t) == 40, "hxa_ioctl_rport_scsi_addr_t");
static_assert(offsetof(hxa_ioctl_rport_scsi_addr_t, host) == 24, "hxa_ioctl_rport_scsi_addr_t");
static_assert(offsetof(hxa_ioctl_rport_scsi_addr_t, lun) == 36, "hxa_ioctl_rport_scsi_addr_t");

// IOCMD_RPORT_SET_SPEED.
typedef struct
{
    hxa_status_t status; //  0
    uint16_t hxad_num;   //  4
    uint16_t vf_id;      //  6  virtual fabric
    uint32_t speed;      //  8  hxa_pport_speed_t
    uint32_t rsvd;       // 12
    wwn_t pwwn;          // 16  of the logical port
    wwn_t rpwwn;         // 24  of the remote port
} hxa_ioctl_rport_set_speed_t;
static_assert(sizeof(hxa_ioctl_rport_set_speed_t) == 32, "hxa_ioctl_rport_set_speed_t");
static_assert(offsetof(hxa_ioctl_rport_set_speed_t, speed) == 8, "hxa_ioctl_rport_set_speed_t");
static_assert(offsetof(hxa_ioctl_rport_set_speed_t, pwwn) == 16, "hxa_ioctl_rport_set_speed_t");
static_assert(offsetof(hxa_ioctl_rport_set_speed_t, rpwwn) == 24, "hxa_ioctl_rport_set_speed_t");

// The symbolic name of a remote port, terminated.
typedef struct
{
    char symname[255]; //  0
} hxa_rport_symname_t;
static_assert(sizeof(hxa_rport_symname_t) == 255, "hxa_rport_symname_t");
