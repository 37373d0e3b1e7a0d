// Where the events of each category stand in the access library's message table.
//
// An event is known by one number: its category times 65536, plus its number in the category, in 32 unsigned bits. The index is
// made when it is first asked for, and constant from then on: any thread may use it.
#pragma once

#include "hxal/hxal.h"
#include "runtime/types.h"

namespace zmlr
{

constexpr uint32 event_id(hxa_aen_category_t category, uint32 event) { return static_cast<uint32>(category) * 65536 + event; }

// Makes the index, if it is not there yet; true.
bool initEventIndex();

// The first and the last index of the category's rows; 0 and 0 for a category without rows.
void getIndexBoundaryForCategory(hxa_aen_category_t category, int* min, int* max);

// The index of the event among the category's rows; false, and nothing written, when it has none.
bool getEventIndexInArray(hxa_aen_category_t category, uint32 id, int* index);

} // namespace zmlr
