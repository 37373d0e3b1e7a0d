// The physical port behind an IOC.
#pragma once

#include "hxal/ioc.h"
#include "hxal/records/port.h"

#ifdef __cplusplus
extern "C"
{
#endif

    // One request: reads the port's attributes.
    hxa_status_t hxal_port_get_attr(const hxal_t* ioc, hxa_pport_attr_t* attr);

#ifdef __cplusplus
}
#endif
