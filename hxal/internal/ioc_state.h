// Which kind an IOC is, and what it answers about its state.
#pragma once

#include "hxal/ioc.h"

namespace hxal
{

inline bool is_ethernet(const hxal_t* ioc) { return ioc && ioc->ioc_type == HXA_IOC_TYPE_LL; }

// Whether the IOC answers, with one request, that it is in this state. A request that fails is a no.
bool is_in_state(const hxal_s& ioc, hxa_ioc_state_t state);

} // namespace hxal
