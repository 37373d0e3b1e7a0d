// The row of a provider that only enumerates, and what all of them do with it.
#pragma once

#include "inventory/class_id.h"
#include "inventory/inventory_request.h"
#include "runtime/instance.h"
#include "runtime/log.h"

#include <span>

namespace zmlr
{

// The managers' way to the instances of a class.
using Get_Instances = Instance_Array (*)(classId_t id, const Inventory_Request& request);
Instance_Array fchba_manager(classId_t id, const Inventory_Request& request);
Instance_Array hdr_manager(classId_t id, const Inventory_Request& request);
Instance_Array server_manager(classId_t id, const Inventory_Request& request);

// A line of the log; without a text there is none.
struct Log_Row
{
    Log_Level level = LL_ERR;
    const char* text = nullptr;
};
void say(std::span<const Log_Row> lines, const char* log_source);

struct Enumeration
{
    const Meta_Class* meta_class;
    Get_Instances get_instances;
    classId_t id;
    Log_Row empty[2]; // what is logged when there is no instance
};

// The row's instances; the provider named `log_source` logs whether there are any. With the model of the one `wanted` instance,
// what the library's memory shows to be another is not read. What that memory no longer knows is found all the same, by reading
// everything: one that is not there costs a whole enumeration, after what its keys lead to. Of several with equal keys the first
// is taken; but one to which the driver has given those keys since the scan comes behind one that had them then.
Instance_Array instances_of(const Enumeration& row, const Instance* wanted, const char* log_source);

} // namespace zmlr
