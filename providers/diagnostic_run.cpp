#include "providers/diagnostic_run.h"

#include "runtime/log.h"
#include "schema/CIM_ConcreteJob.h"
#include "schema/CIM_LogicalDevice.h"

namespace zmlr
{

namespace
{

// Null when the tests do not run on such an element.
const Testable* testable(const Diagnostic_Run& row, const Instance* element)
{
    for (const Testable& each : row.elements)
    {
        if (element && each.meta_class && eqi(element->meta_class->name, each.meta_class->name))
            return &each;
    }
    return nullptr;
}

String address_of_device(const Instance* element)
{
    const auto* device = cast<CIM_LogicalDevice>(element);
    return device && !device->DeviceID.null ? device->DeviceID.value : String();
}

} // namespace

uint32 run_diagnostic(const Diagnostic_Run& row, const String& test_name, const Instance* element, CIM_ConcreteJob*& job,
                      const char* log_source)
{
    const Testable* kind = testable(row, element);
    if (!kind)
    {
        ZMLR_LOG(LL_ERR, "Error: Invalid input object path!");
        return RUN_INVALID_PARAMETER;
    }
    if (kind->remark)
        ZMLR_LOG(LL_INFO, "%s", kind->remark);
    Started started = (DiagnosticHelper::getDiagnosticHelperObject().*row.start)(address_of_device(element), test_name);
    job = cast<CIM_ConcreteJob>(started.job.ptr());
    if (job)
        started.job.steal();
    ZMLR_LOG(LL_INFO, "Return value: %d", static_cast<int>(started.code));
    return started.code;
}

} // namespace zmlr
