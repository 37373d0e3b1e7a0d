#include "diagnostics/diagnostic_helper.h"
#include "diagnostics/test_instances.h"
#include "inventory/served_above.h"

namespace zmlr
{

Instance_Array diagnostic_instances(classId_t id, const Inventory_Request& request)
{
    return DiagnosticHelper::getDiagnosticHelperObject().getInstancesByClass(id, request);
}

Instance_Array diagnostic_services(const Inventory_Request& request) { return getDiagnosticServices(request); }

} // namespace zmlr
