#include "profiles/profile_software_identity.h"

#include "runtime/trace.h"
#include "schema/ZEMLAR_ProfileSoftwareIdentity.h"

#include <cstdio>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "ServerManager";

constexpr const char* product = "Zemlar Adapter CIM Provider";
constexpr const char* version = "2.2.0.0_alpha_bld05";
constexpr uint16 CLASSIFICATION_INSTRUMENTATION = 5; // CIM_SoftwareIdentity.Classifications

} // namespace

Instance_Array getProfileSoftwareIdentityInstances()
{
    const Scope_Trace trace(log_source);
    unsigned short major = 0, minor = 0, revision = 0;
    std::sscanf(version, "%hu.%hu.%hu", &major, &minor, &revision);

    Ref<ZEMLAR_ProfileSoftwareIdentity> software(ZEMLAR_ProfileSoftwareIdentity::create());
    software->InstanceID.set(product);
    software->Name.set(product);
    software->Caption.set(product);
    software->ElementName.set(product);
    software->Manufacturer.set("Zemlar");
    software->Classifications.set({CLASSIFICATION_INSTRUMENTATION});
    software->VersionString.set(version);
    software->MajorVersion.set(major);
    software->MinorVersion.set(minor);
    software->RevisionNumber.set(revision);

    Instance_Array instances;
    instances.adopt(std::move(software));
    return instances;
}

} // namespace zmlr
