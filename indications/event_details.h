// What is told of an event beyond the access library's message: its probable cause, what to do about it, its message identifier.
#pragma once

#include "runtime/types.h"

namespace zmlr
{

// "Unknown" for an event that has no details. `id` is an event_id() (event_index.h).
const char* getEventCauseById(uint32 id);
const char* getEventActionById(uint32 id);
const char* getMessageIDById(uint32 id);

} // namespace zmlr
