// The instance of the latest job, and its association with the element tested.
#pragma once

#include "diagnostics/job_list.h"
#include "runtime/instance.h"

namespace zmlr
{

Instance_Array getDiagnosticJobInstances(Job_List& jobs);

// None when the element is gone.
Instance_Array getDiagnosticAffectedJobElementInstances(Job_List& jobs, const Inventory_Request& request);

} // namespace zmlr
