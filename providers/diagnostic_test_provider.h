// The provider of every class that providers.def marks DIAGNOSTIC_TEST: it enumerates its tests by its row of enumerations.h, and
// runs them by its row of diagnostic_runs.h.
#pragma once

#include "providers/diagnostic_runs.h"
#include "providers/enumerating_provider.h"
#include "schema/CIM_ManagedElement.h"

namespace zmlr
{

struct CIM_DiagnosticSetting;
struct CIM_JobSettingData;

template <class Skeleton> class Diagnostic_Test_Provider : public Enumerating_Provider<Skeleton>
{
public:
    using Class = typename Skeleton::Class;

    using Enumerating_Provider<Skeleton>::Enumerating_Provider;

    // Always a success: how the start went is in the return value.
    Invoke_Method_Status RunDiagnostic(const Class* self, const CIM_ManagedElement* ManagedElement, const CIM_DiagnosticSetting*,
                                       const CIM_JobSettingData*, CIM_ConcreteJob*& Job, Property<uint32>& return_value) override
    {
        const Scope_Trace trace(this->name(), "RunDiagnostic");
        return_value.set(run_diagnostic(_run, self->Name.value, ManagedElement, Job, this->name()));
        return INVOKE_METHOD_OK;
    }

private:
    static constexpr const Diagnostic_Run& _run = row_of(Class::static_meta_class, diagnostic_runs);
};

} // namespace zmlr
