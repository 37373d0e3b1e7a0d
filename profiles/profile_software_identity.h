// The module itself, as the software that implements the profiles.
#pragma once

#include "runtime/instance.h"

namespace zmlr
{

Instance_Array getProfileSoftwareIdentityInstances(); // one ZEMLAR_ProfileSoftwareIdentity

} // namespace zmlr
