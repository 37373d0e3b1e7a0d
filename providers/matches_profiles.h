// The matches of joins_profiles.h that are special to it; the sides are those of their row.
#pragma once

namespace zmlr
{

class Joining;

// Each profile with the host or the object manager, or with neither; then the standard itself, as a profile, with each
// subprofile. Host and object manager name the name space that they live in: the profiles are looked up in the interop one.
void conforming_elements(Joining& joining);

// Each profile with its subprofiles, in the order of the profile's list.
void required_subprofiles(Joining& joining);

} // namespace zmlr
