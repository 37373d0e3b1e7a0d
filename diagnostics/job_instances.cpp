#include "diagnostics/job_instances.h"

#include "runtime/trace.h"
#include "schema/CIM_Job.h"
#include "schema/CIM_ManagedElement.h"
#include "schema/ZEMLAR_AffectedJobElement.h"
#include "schema/ZEMLAR_ConcreteJob.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "DiagnosticHelper";

Ref<ZEMLAR_ConcreteJob> getConcreteJobInstance(const DiagnosticJob& job)
{
    const Scope_Trace trace(log_source);
    Ref<ZEMLAR_ConcreteJob> instance(ZEMLAR_ConcreteJob::create());
    instance->InstanceID.set(job.name);
    instance->Name.set(job.name);
    instance->JobState.set(job.jobState);
    instance->StartTime.set(job.startTime);
    instance->ElapsedTime.set(Datetime()); // never counted
    instance->PercentComplete.set(job.percentComplete);
    return instance;
}

} // namespace

Instance_Array getDiagnosticJobInstances(Job_List& jobs)
{
    const Scope_Trace trace(log_source);
    Instance_Array instances;
    if (const auto job = jobs.latest())
        instances.adopt(getConcreteJobInstance(*job));
    return instances;
}

Instance_Array getDiagnosticAffectedJobElementInstances(Job_List& jobs, const Inventory_Request& request)
{
    const Scope_Trace trace(log_source);
    Instance_Array instances;
    const auto job = jobs.latest();
    if (!job)
        return instances;
    Tested_Elements elements(request);
    if (const Ref<Instance> element = elements.find(job->element))
    {
        Ref<ZEMLAR_AffectedJobElement> association(ZEMLAR_AffectedJobElement::create());
        set_reference(association->AffectedElement, element.ptr());
        set_reference(association->AffectingElement, getConcreteJobInstance(*job).ptr());
        instances.adopt(std::move(association));
    }
    return instances;
}

} // namespace zmlr
