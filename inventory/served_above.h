// Builders that FCHBAManager hands classes to and that lie above this folder: declared here, defined there. They are linked,
// never included from here.
#pragma once

#include "inventory/class_id.h"
#include "inventory/inventory_request.h"
#include "runtime/instance.h"

namespace zmlr
{

// The diagnostic tests, jobs, records and their associations: diagnostics/.
Instance_Array diagnostic_instances(classId_t id, const Inventory_Request& request);
Instance_Array diagnostic_services(const Inventory_Request& request); // every test

} // namespace zmlr
