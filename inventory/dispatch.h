// The dispatch of a manager: which helper builds the instances of which classes.
#pragma once

#include "inventory/class_id.h"
#include "runtime/instance.h"

#include <span>

namespace zmlr
{

// Whether a class is served while the driver gate is closed.
enum class Gate
{
    checked,
    open
};

// The classes first to last (both included) and their builder; null while nothing builds them: they have no instances then.
struct Route
{
    classId_t first;
    classId_t last;
    Gate gate;
    Instance_Array (*build)(classId_t id);
};

// The instances of the class by the first route that holds it. Empty, with a log line of the manager named `log_source`, when
// the gate is closed or no route holds the class.
Instance_Array dispatch(const char* log_source, std::span<const Route> routes, classId_t id);

} // namespace zmlr
