// Records of the asynchronous event notifications (AEN) that the drivers queue for each application.
#pragma once

#include "hxal/records/header.h"

// Entries lie 68 bytes apart behind a 20-byte head, so nothing in here may ask for more than 4-byte alignment.
typedef wwn_t hxa_aen_wwn_t __attribute__((aligned(4)));

// What kind of object an event is about.
typedef enum
{
    HXA_AEN_CAT_ADAPTER = 1,
    HXA_AEN_CAT_PORT = 2,
    HXA_AEN_CAT_LPORT = 3,
    HXA_AEN_CAT_RPORT = 4,
    HXA_AEN_CAT_ITNIM = 5,
    HXA_AEN_CAT_TIN = 6,
    HXA_AEN_CAT_IPFC = 7,
    HXA_AEN_CAT_AUDIT = 8,
    HXA_AEN_CAT_IOC = 9,
    HXA_AEN_CAT_ETHPORT = 10,
    HXA_AEN_MAX_CAT = 10,
} hxa_aen_category_t;

// What happened, by category.
typedef enum
{
    HXA_ADAPTER_AEN_ADD = 1,
    HXA_ADAPTER_AEN_REMOVE = 2,
} hxa_adapter_aen_event_t;

typedef enum
{
    HXA_PORT_AEN_ONLINE = 1,
    HXA_PORT_AEN_OFFLINE = 2,
    HXA_PORT_AEN_RLIR = 3, // registered link incident report
    HXA_PORT_AEN_SFP_INSERT = 4,
    HXA_PORT_AEN_SFP_REMOVE = 5,
    HXA_PORT_AEN_SFP_POM = 6, // optical monitoring
    HXA_PORT_AEN_ENABLE = 7,
    HXA_PORT_AEN_DISABLE = 8,
    HXA_PORT_AEN_AUTH_ON = 9,
    HXA_PORT_AEN_AUTH_OFF = 10,
    HXA_PORT_AEN_DISCONNECT = 11,
    HXA_PORT_AEN_QOS_NEG = 12,
    HXA_PORT_AEN_FABRIC_NAME_CHANGE = 13,
    HXA_PORT_AEN_SFP_ACCESS_ERROR = 14,
    HXA_PORT_AEN_SFP_UNSUPPORT = 15,
} hxa_port_aen_event_t;

typedef enum
{
    HXA_LPORT_AEN_NEW = 1,
    HXA_LPORT_AEN_DELETE = 2,
    HXA_LPORT_AEN_ONLINE = 3,
    HXA_LPORT_AEN_OFFLINE = 4,
    HXA_LPORT_AEN_DISCONNECT = 5,
    HXA_LPORT_AEN_NEW_PROP = 6,
    HXA_LPORT_AEN_DELETE_PROP = 7,
    HXA_LPORT_AEN_NEW_STANDARD = 8,
    HXA_LPORT_AEN_DELETE_STANDARD = 9,
    HXA_LPORT_AEN_NPIV_DUP_WWN = 10,
    HXA_LPORT_AEN_NPIV_FABRIC_MAX = 11,
    HXA_LPORT_AEN_NPIV_UNKNOWN = 12,
} hxa_lport_aen_event_t;

typedef enum
{
    HXA_RPORT_AEN_ONLINE = 1,
    HXA_RPORT_AEN_OFFLINE = 2,
    HXA_RPORT_AEN_DISCONNECT = 3,
    HXA_RPORT_AEN_QOS_PRIO = 4,
    HXA_RPORT_AEN_QOS_FLOWID = 5,
} hxa_rport_aen_event_t;

typedef enum
{
    HXA_ITNIM_AEN_ONLINE = 1,
    HXA_ITNIM_AEN_OFFLINE = 2,
    HXA_ITNIM_AEN_DISCONNECT = 3,
} hxa_itnim_aen_event_t;

typedef enum
{
    HXA_AUDIT_AEN_AUTH_ENABLE = 1,
    HXA_AUDIT_AEN_AUTH_DISABLE = 2,
} hxa_audit_aen_event_t;

typedef enum
{
    HXA_IOC_AEN_HBGOOD = 1, // heartbeat
    HXA_IOC_AEN_HBFAIL = 2,
    HXA_IOC_AEN_ENABLE = 3,
    HXA_IOC_AEN_DISABLE = 4,
    HXA_IOC_AEN_FWMISMATCH = 5,
    HXA_IOC_AEN_FWCFG_ERROR = 6,
    HXA_IOC_AEN_INVALID_VENDOR = 7,
} hxa_ioc_aen_event_t;

typedef enum
{
    HXA_ETHPORT_AEN_LINKUP = 1,
    HXA_ETHPORT_AEN_LINKDOWN = 2,
    HXA_ETHPORT_AEN_ENABLE = 3,
    HXA_ETHPORT_AEN_DISABLE = 4,
} hxa_ethport_aen_event_t;

// Which object it happened to, by category.
typedef struct
{
    char serial_num[12]; //  0
    uint32_t nports;     // 12
    hxa_aen_wwn_t pwwn;  // 16
} hxa_adapter_aen_data_t;
static_assert(sizeof(hxa_adapter_aen_data_t) == 24, "hxa_adapter_aen_data_t");

typedef struct
{
    hxa_aen_wwn_t pwwn;   //  0
    hxa_aen_wwn_t fwwn;   //  8  of the fabric
    int32_t phy_port_num; // 16
    int16_t ioc_type;     // 20  hxa_ioc_type_e
    int16_t level;        // 22  hxa_pom_health_t, of optical monitoring
    mac_t mac;            // 24
    int16_t rsvd;         // 30
} hxa_port_aen_data_t;
static_assert(sizeof(hxa_port_aen_data_t) == 32, "hxa_port_aen_data_t");
static_assert(offsetof(hxa_port_aen_data_t, mac) == 24, "hxa_port_aen_data_t");

typedef struct
{
    uint16_t vf_id;      //  0
    int16_t roles;       //  2
    uint32_t rsvd;       //  4
    hxa_aen_wwn_t ppwwn; //  8  of the physical port
    hxa_aen_wwn_t lpwwn; // 16
} hxa_lport_aen_data_t;
static_assert(sizeof(hxa_lport_aen_data_t) == 24, "hxa_lport_aen_data_t");

typedef struct
{
    uint16_t vf_id;      //  0
    uint16_t rsvd[3];    //  2
    hxa_aen_wwn_t ppwwn; //  8
    hxa_aen_wwn_t lpwwn; // 16
    hxa_aen_wwn_t rpwwn; // 24
    struct
    {
        uint32_t qos_priority; // hxa_qos_priority_t
        uint32_t qos_flow_id;
    } priv; // 32
} hxa_rport_aen_data_t;
static_assert(sizeof(hxa_rport_aen_data_t) == 40, "hxa_rport_aen_data_t");
static_assert(offsetof(hxa_rport_aen_data_t, rpwwn) == 24, "hxa_rport_aen_data_t");

typedef struct
{
    uint16_t vf_id;      //  0
    uint16_t rsvd[3];    //  2
    hxa_aen_wwn_t ppwwn; //  8
    hxa_aen_wwn_t lpwwn; // 16
    hxa_aen_wwn_t rpwwn; // 24
} hxa_itnim_aen_data_t;
static_assert(sizeof(hxa_itnim_aen_data_t) == 32, "hxa_itnim_aen_data_t");

typedef struct
{
    hxa_aen_wwn_t pwwn; //  0
} hxa_audit_aen_data_t;
static_assert(sizeof(hxa_audit_aen_data_t) == 8, "hxa_audit_aen_data_t");

typedef struct
{
    hxa_aen_wwn_t pwwn; //  0
    int16_t ioc_type;   //  8  hxa_ioc_type_e
    mac_t mac;          // 10
} hxa_ioc_aen_data_t;
static_assert(sizeof(hxa_ioc_aen_data_t) == 16, "hxa_ioc_aen_data_t");

typedef struct
{
    mac_t mac;          //  0
    uint16_t rsvd;      //  6
    uint32_t cee_state; //  8  hxa_ethport_cee_state_t
} hxa_ethport_aen_data_t;
static_assert(sizeof(hxa_ethport_aen_data_t) == 12, "hxa_ethport_aen_data_t");

typedef union
{
    uint8_t bytes[40]; //  0
    hxa_adapter_aen_data_t adapter;
    hxa_port_aen_data_t port;
    hxa_lport_aen_data_t lport;
    hxa_rport_aen_data_t rport;
    hxa_itnim_aen_data_t itnim;
    hxa_audit_aen_data_t audit;
    hxa_ioc_aen_data_t ioc;
    hxa_ethport_aen_data_t ethport;
} hxa_aen_data_t;
static_assert(sizeof(hxa_aen_data_t) == 40, "hxa_aen_data_t");

// One event.
typedef struct
{
    uint32_t aen_category;   //  0  hxa_aen_category_t
    uint32_t aen_type;       //  4  event of the category
    hxa_aen_data_t aen_data; //  8
    hxa_timeval_t aen_tv;    // 48
    int32_t seq_num;         // 56
    int32_t hxad_num;        // 60  driver instance of the IOC that raised it
    uint32_t rsvd;           // 64
} hxa_aen_entry_t;
static_assert(sizeof(hxa_aen_entry_t) == 68, "hxa_aen_entry_t");
static_assert(offsetof(hxa_aen_entry_t, aen_tv) == 48, "hxa_aen_entry_t");

// IOCMD_AEN_SYNC. It has no common header.
typedef struct
{
    int32_t hxad_num;            //  0
    int32_t aen_count;           //  4
    uint32_t app_id;             //  8  hxa_aen_app_t
    hxa_status_t status;         // 12
    uint32_t block;              // 16
    hxa_aen_entry_t aen_list[1]; // 20
} hxa_ioctl_aen_t;
static_assert(sizeof(hxa_ioctl_aen_t) == 88, "hxa_ioctl_aen_t");
static_assert(offsetof(hxa_ioctl_aen_t, app_id) == 8, "hxa_ioctl_aen_t");
static_assert(offsetof(hxa_ioctl_aen_t, aen_list) == 20, "hxa_ioctl_aen_t");

#define HXA_AEN_MAX_ENTRIES 64

// IOCMD_AEN_GET: as above, with room for a whole batch. Its command number tells 88 bytes all the same; how many entries
// there is room for, the driver reads in `aen_count`.
typedef struct
{
    int32_t hxad_num;                              //  0  driver instance of the IOC whose queue is read
    int32_t aen_count;                             //  4  in: room; out: entries delivered
    uint32_t app_id;                               //  8  hxa_aen_app_t
    hxa_status_t status;                           // 12
    uint32_t block;                                // 16  0: do not wait
    hxa_aen_entry_t aen_list[HXA_AEN_MAX_ENTRIES]; // 20
} hxal_ioctl_aen_t;
static_assert(sizeof(hxal_ioctl_aen_t) == 4372, "hxal_ioctl_aen_t");
static_assert(offsetof(hxal_ioctl_aen_t, aen_list) == 20, "hxal_ioctl_aen_t");
