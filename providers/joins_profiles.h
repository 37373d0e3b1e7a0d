// The associations of the profile classes: with each other, with the software that implements them, with what conforms to them;
// and those of the object manager.
#pragma once

#include "providers/join.h"
#include "providers/matches_profiles.h"
#include "schema/CIM_ManagedElement.h"
#include "schema/CIM_RegisteredProfile.h"
#include "schema/CIM_RegisteredSubProfile.h"
#include "schema/CIM_SoftwareIdentity.h"
#include "schema/ZEMLAR_CommMechHostedAccessPoint.h"
#include "schema/ZEMLAR_CommMechanismForManager.h"
#include "schema/ZEMLAR_ElementConformsToProfile.h"
#include "schema/ZEMLAR_NamespaceInManager.h"
#include "schema/ZEMLAR_ObjectManagerHostedService.h"
#include "schema/ZEMLAR_ProfileElementSoftwareIdentity.h"
#include "schema/ZEMLAR_SubProfileRequiresProfile.h"

namespace zmlr
{

// clang-format off
inline constexpr Join profile_joins[] = {

    // The profiles.
    join(conforming_elements, side_of<ZEMLAR_RegisteredProfile, &ZEMLAR_ElementConformsToProfile::ConformantStandard>({LL_ERR, "Error: No instancesof RegisteredProfile class returned."}),
                              exactly_one(side_of<ZEMLAR_ComputerSystem, &ZEMLAR_ElementConformsToProfile::ManagedElement>({LL_ERR, "Invalid number of ComputerSystem class instances."})),
                              exactly_one(side_of<ZEMLAR_ObjectManager, &ZEMLAR_ElementConformsToProfile::ManagedElement>({LL_ERR, "Invalid number of ObjectManager class instances."})),
                              side_of<ZEMLAR_RegisteredSubProfile, &ZEMLAR_ElementConformsToProfile::ManagedElement>()),
    join(required_subprofiles, side_of<ZEMLAR_RegisteredProfile, &ZEMLAR_SubProfileRequiresProfile::Antecedent>({LL_ERR, "Invalid number of instances"}),
                               side_of<ZEMLAR_RegisteredSubProfile, &ZEMLAR_SubProfileRequiresProfile::Dependent, &ZEMLAR_RegisteredSubProfile::InstanceID>({LL_ERR, "Invalid number of instances"})),
    join(all_pairs, exactly_one(side_of<ZEMLAR_ProfileSoftwareIdentity, &ZEMLAR_ProfileElementSoftwareIdentity::Antecedent>({LL_ERR, "Invalid number of ProfileSoftwareIdentity instances returned."})),
                    side_of<ZEMLAR_RegisteredProfile, &ZEMLAR_ProfileElementSoftwareIdentity::Dependent>(),
                    side_of<ZEMLAR_RegisteredSubProfile, &ZEMLAR_ProfileElementSoftwareIdentity::Dependent>()),

    // The object manager.
    join(all_pairs, exactly_one(side<&ZEMLAR_NamespaceInManager::Antecedent>({LL_ERR, "Invalid number of ObjectManager class instances"})),
                    side<&ZEMLAR_NamespaceInManager::Dependent>()),
    join(all_pairs, exactly_one(side<&ZEMLAR_CommMechanismForManager::Antecedent>({LL_ERR, "Invalid number of ObbjectManager instances"})),
                    side<&ZEMLAR_CommMechanismForManager::Dependent>()),
    join(all_pairs, exactly_one(side<&ZEMLAR_CommMechHostedAccessPoint::Antecedent>({LL_ERR, "Invalid number of ComputerSystem instances"})),
                    side<&ZEMLAR_CommMechHostedAccessPoint::Dependent>()),
    join(all_pairs, exactly_one(side<&ZEMLAR_ObjectManagerHostedService::Antecedent>({LL_ERR, "Invalid number of reference class instances"})),
                    side<&ZEMLAR_ObjectManagerHostedService::Dependent>()),
};
// clang-format on

} // namespace zmlr
