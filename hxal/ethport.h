// The Ethernet side of a converged port.
#pragma once

#include "hxal/ioc.h"
#include "hxal/records/ethport.h"

#ifdef __cplusplus
extern "C"
{
#endif

    // Reads the port's state and speeds, and the largest payload of a frame (bytes).
    hxa_status_t hxal_ethport_get_attr(const hxal_t* ioc, hxa_ethport_attr_t* attr);

    // What the network driver and the two halves of its function count; prints a message when the request fails.
    hxa_status_t hxal_ethport_get_stats(const hxal_t* ioc, hxa_ethport_stats_t* stats);

    // The request of hxal_port_reset_stats().
    hxa_status_t hxal_ethport_reset_stats(const hxal_t* ioc);

#ifdef __cplusplus
}
#endif
