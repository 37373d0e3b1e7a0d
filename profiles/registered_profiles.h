// The management profiles and subprofiles that the module registers, and which subprofile belongs to which profile.
#pragma once

#include "runtime/array.h"
#include "runtime/instance.h"

namespace zmlr
{

Instance_Array getRegisteredProfileInstances();    // ZEMLAR_RegisteredProfile
Instance_Array getRegisteredSubProfileInstances(); // ZEMLAR_RegisteredSubProfile

// The InstanceIDs of the subprofiles of the profile with that RegisteredName (compared without regard to case), in their order.
Array<String> getSubProfilesOfProfile(const String& registered_name);

} // namespace zmlr
