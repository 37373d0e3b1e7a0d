// enum_instances of every provider whose instances come from a manager.
#pragma once

#include "cmpi/handlers.h"
#include "inventory/class_id.h"
#include "runtime/instance.h"
#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

// The managers' way to the instances of a class.
using Get_Instances = Instance_Array (*)(classId_t id);
Instance_Array from_fchba_manager(classId_t id);
Instance_Array from_hdr_manager(classId_t id);

// What a provider enumerates, and what it logs when there is nothing.
struct Enumeration
{
    const char* log_source;
    classId_t id;
    Get_Instances get_instances;
    const char* empty_message;
    const char* empty_remark = nullptr; // a second line
};

void log_empty(const Enumeration& source);

// Hands a clone of each instance of the class (or a subclass) to the handler, in order, until it says stop. Always a success.
template <class T> Enum_Instances_Status enumerate(const Enumeration& source, Enum_Instances_Handler<T>& handler)
{
    const char* const log_source = source.log_source;
    const Scope_Trace trace(log_source, "enum_instances");
    const Instance_Array instances = source.get_instances(source.id);
    if (instances.empty())
    {
        log_empty(source);
        return ENUM_INSTANCES_OK;
    }

    ZMLR_LOG(LL_DBG, "Returning instances");
    for (const Instance* instance : instances)
    {
        const T* found = cast<T>(instance);
        if (found && !handler.handle(clone(found)))
            break;
    }
    return ENUM_INSTANCES_OK;
}

} // namespace zmlr
