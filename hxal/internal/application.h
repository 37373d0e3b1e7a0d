// What the library keeps for the whole process.
#pragma once

#include "hxal/records/types.h"

namespace hxal
{

// The identity that hxal_libinit() stored.
hxa_aen_app_t current_application();

} // namespace hxal
