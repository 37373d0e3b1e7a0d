// From an event to the callbacks that are registered for it. Each kind of event is a row: which registrations an event is for,
// how they are called, and who they are. An event's way is aen_thread.cpp, dispatch_event(), its kind's row, the row's list.
#pragma once

#include "hxal/internal/aen_registrations.h"

#include <vector>

namespace hxal
{

struct Kind
{
    hxa_aen_category_t category;
    Registration_List::Is_For is_for;
    Registration_List::Call call;
    bool tells_unknown_handles; // on standard output
    Registration_List registrations = {};
};

// The row of a category; a category of no kind: null.
Kind* kind_of(uint32_t category);

// Calls the callbacks that an event is for. Events of no kind are dropped.
void dispatch_event(const hxa_aen_entry_t& event);

// The descriptors that registrations were made on, each as often as it was.
std::vector<int> hxal_aen_fd_collect();

} // namespace hxal
