// Diagnostics of the port behind an IOC.
#pragma once

#include "hxal/ioc.h"

#ifdef __cplusplus
extern "C"
{
#endif

    // Asks whether a loopback test holds the port: HXA_STATUS_OK when none does.
    hxa_status_t hxal_diag_get_lb_status(const hxal_t* ioc);

#ifdef __cplusplus
}
#endif
