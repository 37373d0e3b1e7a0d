// The instances of the tests and of the software that carries them out.
#pragma once

#include "inventory/class_id.h"
#include "inventory/inventory_request.h"
#include "runtime/instance.h"

namespace zmlr
{

// The tests of one of the four test classes.
Instance_Array getDiagnosticTestInstances(classId_t class_id, const Inventory_Request& request);

// All tests of all classes.
Instance_Array getDiagnosticServices(const Inventory_Request& request);

// One request for its version.
Ref<Instance> getDiagnosticSoftwareIdentityInstance();

} // namespace zmlr
