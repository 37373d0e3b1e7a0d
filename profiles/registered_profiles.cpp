#include "profiles/registered_profiles.h"

#include "runtime/trace.h"
#include "schema/ZEMLAR_RegisteredProfile.h"
#include "schema/ZEMLAR_RegisteredSubProfile.h"

#include <span>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "ServerManager";

// CIM_RegisteredProfile.RegisteredOrganization
constexpr uint16 DMTF = 2;
constexpr uint16 SNIA = 11;

constexpr uint16 SLP = 3; // CIM_RegisteredProfile.AdvertiseTypes

struct Profile
{
    const char* name;
    const char* title;
    const char* description;
    uint16 organization;
    const char* version;
};

// clang-format off
constexpr Profile profiles[] = {
    {"SMI-S",                     "SMI-S",                             "This instance models the SMI-S standard as such",                  SNIA, "1.2.0"},
    {"FC HBA",                    "FC HBA Profile",                    "The FC HBA Profile models the HBA device",                         SNIA, "1.2.0"},
    {"Server",                    "Server Profile",                    "The Server Profile models the CIM Server",                         SNIA, "1.2.0"},
    {"Host Discovered Resources", "Host Discovered Resources Profile", "The HDR profile models the discovered storage resources",          SNIA, "1.2.0"},
    {"Storage HBA",               "Storage HBA Profile",               "The Storage HBA Profile models the manageable elements of an HBA", SNIA, "1.3.0"},
};

constexpr Profile subprofiles[] = {
    {"FC Initiator Ports",    "FC Initiator Ports subprofile",  "The FC Initiator Ports subprofile models the ports present in the HBA device",             SNIA, "1.2.0"},
    {"Profile Registration",  "Profile Registration Profile",   "The Profile Registration Profile models the profiles registered in the object manager.",   SNIA, "1.0.0"},
    {"Access Points",         "Access Points subprofile",       "This models the management service(s) points available to the user.",                      SNIA, "1.2.0"},
    {"Software Update",       "Software Update profile",        "This models the software installation service available to the user.",                     DMTF, "1.0.0"},
    {"Software Inventory",    "Software Inventory profile",     "This models the softwares installed and available for installation on the system.",        DMTF, "1.0.0"},
    {"Physical Asset",        "Physical Asset profile",         "This models the physical aspects of the adapter hardware.",                                DMTF, "1.0.2"},
    {"Ethernet Port",         "Ethernet Port profile",          "This models the ethernet characteristics of the port present in the adapter.",             DMTF, "1.0.0"},
    {"Diagnostics Profile",   "Diagnostics Profile",            "This models the diagnostic services available for the adapters and its ports.",            DMTF, "2.0.0"},
    {"Host LAN Network Port", "Host LAN Network Port Profile",  "This models the network interfaces associated with the network ports",                     DMTF, "1.0.0"},
    {"FCoE Initiator Ports",  "FCoE Initiator Ports Profile",   "This models the FCoE functionality of CNAs",                                               SNIA, "1.0.0"},
};

// In the order in which a profile's subprofiles are told.
constexpr struct { const char* profile; const char* subprofile; } parts[] = {
    {"FC HBA",      "FC Initiator Ports"},
    {"FC HBA",      "Software Update"},
    {"FC HBA",      "Software Inventory"},
    {"FC HBA",      "Access Points"},
    {"FC HBA",      "Physical Asset"},
    {"FC HBA",      "Ethernet Port"},
    {"FC HBA",      "Diagnostics Profile"},
    {"FC HBA",      "Host LAN Network Port"},
    {"Server",      "Profile Registration"},
    {"Storage HBA", "FCoE Initiator Ports"},
};
// clang-format on

template <class T> Instance_Array instances_of(std::span<const Profile> rows)
{
    Instance_Array instances;
    for (const Profile& row : rows)
    {
        Ref<T> profile(T::create());
        profile->InstanceID.set(row.name);
        profile->RegisteredName.set(row.name);
        profile->Caption.set(row.title);
        profile->ElementName.set(row.title);
        profile->Description.set(row.description);
        profile->RegisteredOrganization.set(row.organization);
        profile->RegisteredVersion.set(row.version);
        profile->AdvertiseTypes.set({SLP});
        instances.adopt(std::move(profile));
    }
    return instances;
}

} // namespace

Instance_Array getRegisteredProfileInstances()
{
    const Scope_Trace trace(log_source);
    return instances_of<ZEMLAR_RegisteredProfile>(profiles);
}

Instance_Array getRegisteredSubProfileInstances()
{
    const Scope_Trace trace(log_source);
    return instances_of<ZEMLAR_RegisteredSubProfile>(subprofiles);
}

Array<String> getSubProfilesOfProfile(const String& registered_name)
{
    const Scope_Trace trace(log_source);
    Array<String> names;
    for (const auto& part : parts)
    {
        if (registered_name.equali(part.profile))
            names.append(part.subprofile);
    }
    return names;
}

} // namespace zmlr
