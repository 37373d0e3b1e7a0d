// What the adapter list needs to know of the IOC list.
#pragma once

#include "hxal/internal/list.h"

namespace hxal
{

// A share of the descriptor that the listed IOCs with this number use; none: null.
std::shared_ptr<Descriptor> descriptor_of(int fd);

void keep_iocs(); // for hxal_libkeep()

} // namespace hxal
