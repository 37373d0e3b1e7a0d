// Values of the remote ports that a logical port has discovered, and of the initiator-target nexus ("itnim") to them.
#pragma once

#include "hxal/records/header.h"

typedef enum
{
    HXA_RPORT_UNINIT = 0,
    HXA_RPORT_OFFLINE = 1,
    HXA_RPORT_PLOGI = 2,
    HXA_RPORT_ONLINE = 3,
    HXA_RPORT_PLOGI_RETRY = 4,
    HXA_RPORT_NSQUERY = 5,
    HXA_RPORT_ADISC = 6,
    HXA_RPORT_LOGO = 7,
    HXA_RPORT_LOGORCV = 8,
    HXA_RPORT_NSDISC = 9,
} hxa_rport_state_t;

typedef enum
{
    HXA_ITNIM_OFFLINE = 0,
    HXA_ITNIM_PRLI_SEND = 1,
    HXA_ITNIM_PRLI_SENT = 2,
    HXA_ITNIM_PRLI_RETRY = 3,
    HXA_ITNIM_HCB_ONLINE = 4,
    HXA_ITNIM_ONLINE = 5,
    HXA_ITNIM_HCB_OFFLINE = 6,
    HXA_ITNIM_INITIATIOR = 7, // the driver's own spelling
} hxa_itnim_state_t;
