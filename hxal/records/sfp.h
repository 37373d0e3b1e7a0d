// Values of the pluggable transceiver (SFP) of a port.
#pragma once

#include "hxal/records/header.h"

typedef enum
{
    HXA_SFP_MEDIA_UNKNOWN = 0,
    HXA_SFP_MEDIA_CU = 1, // copper
    HXA_SFP_MEDIA_LW = 2, // long wave
    HXA_SFP_MEDIA_SW = 3, // short wave
    HXA_SFP_MEDIA_EL = 4, // electrical
    HXA_SFP_MEDIA_UNSUPPORT = 5,
} hxa_defs_sfp_media_t;
