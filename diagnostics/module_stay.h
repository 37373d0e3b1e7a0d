// Keeps the module in memory for threads that may outlive every interface of it.
#pragma once

namespace zmlr
{

// From now on the module is not unloaded, whoever closes it, and the end of the process leaves the access library's handles
// alone. False when the loader refuses. May be called again. Not to be called by two threads at once.
bool stay_in_memory();

} // namespace zmlr
