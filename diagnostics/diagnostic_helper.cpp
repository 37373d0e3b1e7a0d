#include "diagnostics/diagnostic_helper.h"

#include "diagnostics/job_instances.h"
#include "diagnostics/record_instances.h"
#include "diagnostics/test_instances.h"
#include "hxal/hxal.h"
#include "inventory/provider_util.h"
#include "runtime/log.h"
#include "runtime/trace.h"
#include "schema/ZEMLAR_CompletionRecordAppliesToElement.h"
#include "schema/ZEMLAR_DiagnosticCompletionRecord.h"
#include "schema/ZEMLAR_DiagnosticServiceRecord.h"
#include "schema/ZEMLAR_ServiceRecordAppliesToElement.h"

#include <algorithm>
#include <iterator>
#include <new>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "DiagnosticHelper";

Instance_Array test_instances(DiagnosticHelper&, classId_t id, const Inventory_Request& request)
{
    return getDiagnosticTestInstances(id, request);
}

Instance_Array software_identity(DiagnosticHelper&, classId_t, const Inventory_Request&)
{
    Instance_Array instances;
    instances.adopt(getDiagnosticSoftwareIdentityInstance());
    return instances;
}

Instance_Array job(DiagnosticHelper& helper, classId_t, const Inventory_Request&)
{
    return getDiagnosticJobInstances(helper.jobs());
}

Instance_Array affected_element(DiagnosticHelper& helper, classId_t, const Inventory_Request& request)
{
    return getDiagnosticAffectedJobElementInstances(helper.jobs(), request);
}

Instance_Array service_records(DiagnosticHelper& helper, classId_t, const Inventory_Request& request)
{
    return getDiagnosticRecordInstances(helper.service_records(), service_record_kind, request);
}

Instance_Array completion_records(DiagnosticHelper& helper, classId_t, const Inventory_Request& request)
{
    return getDiagnosticRecordInstances(helper.completion_records(), completion_record_kind, request);
}

Instance_Array service_record_elements(DiagnosticHelper& helper, classId_t, const Inventory_Request& request)
{
    return getRecordAppliesToElementInstances(helper.service_records(), service_record_kind, request);
}

Instance_Array completion_record_elements(DiagnosticHelper& helper, classId_t, const Inventory_Request& request)
{
    return getRecordAppliesToElementInstances(helper.completion_records(), completion_record_kind, request);
}

// clang-format off
constexpr struct
{
    classId_t id;
    Instance_Array (*build)(DiagnosticHelper& helper, classId_t id, const Inventory_Request& request);
} builders[] = {
    {CLASSID_MemoryDiagnosticTest,             test_instances},
    {CLASSID_LoopbackDiagnosticTest,           test_instances},
    {CLASSID_PCILoopbackDiagnosticTest,        test_instances},
    {CLASSID_EthLoopbackDiagnosticTest,        test_instances},
    {CLASSID_DiagnosticSoftwareIdentity,       software_identity},
    {CLASSID_ConcreteJob,                      job},
    {CLASSID_DiagnosticServiceRecord,          service_records},
    {CLASSID_DiagnosticCompletionRecord,       completion_records},
    {CLASSID_AffectedJobElement,               affected_element},
    {CLASSID_ServiceRecordAppliesToElement,    service_record_elements},
    {CLASSID_CompletionRecordAppliesToElement, completion_record_elements},
};
// clang-format on

} // namespace

// Never destroyed: before the first run it holds nothing that would have to be freed, and after that the module stays in memory
// and a run may still use it while the process ends.
DiagnosticHelper& DiagnosticHelper::getDiagnosticHelperObject()
{
    alignas(DiagnosticHelper) static unsigned char place[sizeof(DiagnosticHelper)];
    static DiagnosticHelper& helper = *new (place) DiagnosticHelper;
    return helper;
}

Instance_Array DiagnosticHelper::getInstancesByClass(classId_t id, const Inventory_Request& request)
{
    const Scope_Trace trace(log_source);
    ZMLR_LOG(LL_INFO, "Requested Class : %s", ProviderUtil::getClassName(id).c_str());
    if (hxal_adapter_get_num() == 0)
    {
        ZMLR_LOG(LL_WARN, "No adapters in the system for running diagnostics.");
        return Instance_Array();
    }
    const auto* const row = std::ranges::find_if(builders, [id](const auto& builder) { return builder.id == id; });
    if (row != std::end(builders))
        return row->build(*this, id, request);
    ZMLR_LOG(LL_WARN, "Not supported class is requested.");
    return Instance_Array();
}

void DiagnosticHelper::generateDiagnosticRecord(const String& message, const DiagnosticTestInput& input,
                                                diag_compl_record_state_t state)
{
    const Scope_Trace trace(log_source);
    DiagnosticRecord record;
    record.recordData = message;
    record.serviceName = ProviderUtil::getDiagTestName(input.test->id);
    record.element = input.element;
    record.completionState = state;
    Record_List& records = state == COMPLETION_NONE ? _service_records : _completion_records;
    records.add(std::move(record), input.jobLabel, _record_counter);
}

} // namespace zmlr
