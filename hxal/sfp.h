// What the driver makes of the transceiver in a port; hxal_diag_sfp_query() reads the transceiver itself.
//
// Every call is one request. HXA_STATUS_NO_SFP_DEV when there is no transceiver.
#pragma once

#include "hxal/ioc.h"
#include "hxal/records/sfp.h"

#ifdef __cplusplus
extern "C"
{
#endif

    // Its medium, any number that the driver gives; hxal_get_sfp_media() has the words. A null `media` is allowed.
    hxa_status_t hxal_sfp_media(const hxal_t* ioc, hxa_defs_sfp_media_t* media);

    // Whether it supports a speed (hxa_pport_speed_t): HXA_STATUS_OK, else the driver's reason.
    hxa_status_t hxal_sfp_speed(const hxal_t* ioc, uint32_t speed);

#ifdef __cplusplus
}
#endif
