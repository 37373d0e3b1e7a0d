// Statistics by name: blocks of counters as pairs of a name and a value.
//
// The caller's array has room for as many pairs as the operation writes (HXAL_..._STATS). It is written only on
// HXA_STATUS_OK; any other status, of the call or of the driver, leaves it alone. The pairs come in the order of the driver's
// counters, which are the fields of their records; names are terminated, for people, and not always unique.
#pragma once

#include "hxal/ioc.h"
#include "hxal/records/fcoe.h"
#include "hxal/records/lport.h"
#include "hxal/records/port_stats.h"

#ifdef __cplusplus
extern "C"
{
#endif

    typedef struct
    {
        char name[64];
        uint32_t value;
    } hxal_stats_t;
    static_assert(sizeof(hxal_stats_t) == 68, "hxal_stats_t");

    typedef struct
    {
        char name[64];
        uint64_t value;
    } hxal_stats_long_t;
    static_assert(sizeof(hxal_stats_long_t) == 72, "hxal_stats_long_t");

    // How many pairs an operation writes.
    enum
    {
        HXAL_FC_PORT_STATS = 29,
        HXAL_ETH_PORT_STATS = 38,
        HXAL_FCOE_STATS = 45,
        HXAL_LPORT_STATS = 43,
    };

    // The physical port: HXAL_FC_PORT_STATS pairs for an IOC of type FC, HXAL_ETH_PORT_STATS for every other.
    hxa_status_t hxal_port_get_stats(const hxal_t* ioc, hxal_stats_long_t* stats);

    // FCoE: HXAL_FCOE_STATS pairs. An FC port counts something else (hxa_fcqos_stats_t), which gets the same names.
    hxa_status_t hxal_fcoe_get_stats(const hxal_t* ioc, hxal_stats_long_t* stats);

    // A logical port's dealings with the fabric's name and management servers: HXAL_LPORT_STATS pairs. The rejects of both carry
    // the same name, "NS command rejects".
    hxa_status_t hxal_lport_get_stats(const hxal_t* ioc, uint16_t vf_id, wwn_t pwwn, hxal_stats_t* stats);

    // Pairs the first `count` values and names by position; names are cut to 63 characters.
    void hxal_stats_to_nv_pair(const uint32_t* values, hxal_stats_t* out, const char* const* names, int count);
    void hxal_stats_long_to_nv_pair(const uint64_t* values, hxal_stats_long_t* out, const char* const* names, int count);

#ifdef __cplusplus
}
#endif
