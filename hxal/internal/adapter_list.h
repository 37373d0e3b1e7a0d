// What the adapter look-ups need to know of the scan.
#pragma once

#include "hxal/internal/ioc_list.h"

namespace hxal
{

// The first adapter of the last scan; none: null.
hxal_adapter_t* adapter_list();

void keep_adapters(); // for hxal_libkeep()

} // namespace hxal
