// The Fibre Channel side of an IOC: its configuration, interrupt moderation and firmware counters.
//
// Every call is one request at most. An Ethernet IOC has no such side: all but hxal_ioc_intr_set() refuse it with
// HXA_STATUS_FAILED before any request.
#pragma once

#include "hxal/ioc.h"
#include "hxal/records/iocfc.h"

#ifdef __cplusplus
extern "C"
{
#endif

    // Reads how firmware, driver and interrupts are configured. Refusing an Ethernet IOC, prints "Not an FC IOC".
    hxa_status_t hxal_iocfc_get_attr(const hxal_t* ioc, hxa_iocfc_attr_t* attr);

    // Read and clear the firmware's counters.
    hxa_status_t hxal_iocfc_get_stats(const hxal_t* ioc, hxa_iocfc_stats_t* stats);
    hxa_status_t hxal_iocfc_reset_stats(const hxal_t* ioc);

    // Set the interrupt moderation: whether the card holds interrupts back, and for how long (`delay`, `latency`, in
    // microseconds). What the driver accepts is recorded in the configuration. The first form takes any IOC.
    hxa_status_t hxal_ioc_intr_set(const hxal_t* ioc, hxa_boolean_t coalesce, uint16_t delay, uint16_t latency);
    hxa_status_t hxal_iocfc_intr_set(const hxal_t* ioc, hxa_boolean_t coalesce, uint16_t delay, uint16_t latency);

#ifdef __cplusplus
}
#endif
