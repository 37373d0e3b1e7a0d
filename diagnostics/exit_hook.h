// The end of the process in the middle of a run.
#pragma once

#include "diagnostics/job_list.h"

namespace zmlr
{

// From now on the process does not end before the running job's element is back in service, or ten seconds have passed; the log
// tells when they have. Nothing starts meanwhile, and the run skips its pauses. May be called again.
void hook_exit(Job_List& jobs);

} // namespace zmlr
