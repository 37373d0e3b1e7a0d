// The associations of the diagnostic tests: which test may run on what, who carries them out, and whose job there is.
#pragma once

#include "providers/join.h"
#include "providers/matches_diagnostics.h"
#include "providers/matches_inventory.h"
#include "schema/ZEMLAR_AvailableDiagnosticServiceForAdapter.h"
#include "schema/ZEMLAR_AvailableDiagnosticServiceForEthernetPort.h"
#include "schema/ZEMLAR_AvailableDiagnosticServiceForFCPort.h"
#include "schema/ZEMLAR_DiagnosticElementSoftwareIdentity.h"
#include "schema/ZEMLAR_DiagnosticTest.h"
#include "schema/ZEMLAR_OwningJobElement.h"

namespace zmlr
{

// clang-format off
inline constexpr Join diagnostic_joins[] = {
    join(all_pairs, side<&ZEMLAR_AvailableDiagnosticServiceForAdapter::UserOfService>({LL_WARN, "No adapters are present in the host for running dianostics."}),
                    side<&ZEMLAR_AvailableDiagnosticServiceForAdapter::ServiceProvided>({LL_WARN, "No diagnostic tests are available."}, tests_of_adapters)),
    join(tests_on_ports_of_adapters, side_without_role<ZEMLAR_PortController>({LL_WARN, "No adapters are available."}, all_of<ZEMLAR_PortController>),
                                     side<&ZEMLAR_AvailableDiagnosticServiceForFCPort::ServiceProvided>({LL_WARN, "No diagnostic tests are available."}, tests_of_fc_ports),
                                     of_each<fc_ports_of>(side<&ZEMLAR_AvailableDiagnosticServiceForFCPort::UserOfService>({LL_WARN, "No ports are present for running dianostics."}))),
    join(all_pairs, side<&ZEMLAR_AvailableDiagnosticServiceForEthernetPort::UserOfService>({LL_WARN, "No ethernet ports are present for running dianostics."}),
                    side<&ZEMLAR_AvailableDiagnosticServiceForEthernetPort::ServiceProvided>({LL_WARN, "No diagnostic tests are available."}, tests_of_ethernet_ports)),
    join(all_pairs, side<&ZEMLAR_DiagnosticElementSoftwareIdentity::Dependent>({LL_WARN, "No diagnostic services are available."}, all_tests),
                    exactly_one(side<&ZEMLAR_DiagnosticElementSoftwareIdentity::Antecedent>({LL_WARN, "No diagnostic softwares are installed."}), {LL_ERR, "Error: Invalid number of instances."})),
    join(equal_keys, side<&ZEMLAR_OwningJobElement::OwnedElement, &ZEMLAR_ConcreteJob::InstanceID>({LL_INFO, "No jobs are currently running in the system."}),
                     optional(side<&ZEMLAR_OwningJobElement::OwningElement, &ZEMLAR_DiagnosticTest::Name>({}, all_tests))),
};
// clang-format on

} // namespace zmlr
