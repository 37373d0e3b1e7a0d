// The dispatch of a manager: which helper builds the instances of which classes.
#pragma once

#include "inventory/class_id.h"
#include "inventory/inventory_request.h"
#include "runtime/instance.h"

#include <span>

namespace zmlr
{

// Whether a class has instances while the driver gate is closed.
enum class Driver
{
    needed,
    not_needed
};

// The classes first to last (both included) and their builder.
struct Route
{
    classId_t first;
    classId_t last;
    Driver driver;
    Instance_Array (*build)(classId_t id, const Inventory_Request& request);
};

// The instances of the class by the first route that holds it. Empty, with a log line of the manager named `log_source`, when
// the gate is closed or no route holds the class.
Instance_Array dispatch(const char* log_source, std::span<const Route> routes, classId_t id, const Inventory_Request& request);

} // namespace zmlr
