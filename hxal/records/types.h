// Basic types of the driver interface: names, addresses, truth values, and the enumerations that every record may use.
//
// The record headers are plain C11 and C++. A record holds what a driver sent, and a driver may send any value: inside
// records an enumeration is therefore kept as its 32-bit number, with the enumeration's name in the comment.
// All records are in the byte order of the host; every reserved byte is a field, so that no compiler adds any.
#pragma once

#include <assert.h>
#include <stddef.h>
#include <stdint.h>

// A World Wide Name: its 8 bytes in memory order as the driver delivers them. Compare and copy it as one value; to print
// it, walk the bytes, never the integer.
typedef uint64_t wwn_t;

// The address of a port in the fabric (`pid` in records) lies as it goes over the wire (FC-FS-2): domain, area, port, from the
// lowest memory address on, and a 0 behind them. Like a name it is walked, never read as a number.

// A SCSI LUN, 8 bytes as delivered.
typedef uint64_t lun_t;

typedef struct
{
    uint8_t mac[6]; //  0
} mac_t;
static_assert(sizeof(mac_t) == 6, "mac_t");

typedef enum
{
    HXA_FALSE = 0,
    HXA_TRUE = 1,
} hxa_boolean_t;
static_assert(sizeof(hxa_boolean_t) == 4, "hxa_boolean_t");

typedef struct
{
    uint32_t tv_sec;  //  0
    uint32_t tv_usec; //  4
} hxa_timeval_t;
static_assert(sizeof(hxa_timeval_t) == 8, "hxa_timeval_t");

// What an I/O controller is.
typedef enum
{
    HXA_IOC_TYPE_FC = 1,
    HXA_IOC_TYPE_FCoE = 2,
    HXA_IOC_TYPE_LL = 3, // the Ethernet function of a converged network adapter
} hxa_ioc_type_e;

// Who asks: the driver queues events per application.
typedef enum
{
    hxa_aen_app_tessik = 0,
    hxa_aen_app_quillon = 1,
    hxa_aen_app_cim = 2,
    hxa_aen_app_snia = 3,
    hxa_aen_app_test = 4,
} hxa_aen_app_t;
static_assert(sizeof(hxa_aen_app_t) == 4, "hxa_aen_app_t");

// How urgent a driver log entry is.
typedef enum
{
    HXA_LOG_INVALID = 0,
    HXA_LOG_CRITICAL = 1,
    HXA_LOG_ERROR = 2,
    HXA_LOG_WARNING = 3,
    HXA_LOG_INFO = 4,
    HXA_LOG_NONE = 5,
    HXA_LOG_LEVEL_MAX = 5,
} hxa_log_severity_t;
