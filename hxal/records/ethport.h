// Values of the Ethernet side of a converged port.
#pragma once

#include "hxal/records/header.h"

typedef enum
{
    HXA_ETHPORT_CEE_LINKDOWN = 1,
    HXA_ETHPORT_CEE_LINKUP = 2,
} hxa_ethport_cee_state_t;
