// From the event thread to the registrations of all kinds.
#pragma once

#include "hxal/records/aen.h"

#include <vector>

namespace hxal
{

// The descriptors that registrations were made on, each as often as it was.
std::vector<int> hxal_aen_fd_collect();

// Calls the callbacks that an event is for. Events of other categories are dropped.
void dispatch_event(const hxa_aen_entry_t& entry);

} // namespace hxal
