// One function of a port by itself: service, and the counters of FCoE (Fibre Channel over Ethernet, FC-BB-5).
//
// The requests go to the driver of the IOC, whatever its type; the counters have meaning on a converged port.
#pragma once

#include "hxal/ioc.h"
#include "hxal/records/fcoe.h"

#ifdef __cplusplus
extern "C"
{
#endif

    // Put this function of the port into service, or out of it; hxal_port_enable() and hxal_port_disable() treat both functions.
    // On HXA_STATUS_OK the configuration model records it.
    hxa_status_t hxal_fcoe_port_enable(const hxal_t* ioc);
    hxa_status_t hxal_fcoe_port_disable(const hxal_t* ioc);

    // Sets the counters to 0; hxal_fcoe_get_stats() reads them.
    hxa_status_t hxal_fcoe_reset_stats(const hxal_t* ioc);

#ifdef __cplusplus
}
#endif
