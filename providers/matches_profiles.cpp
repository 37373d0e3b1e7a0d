#include "providers/matches_profiles.h"

#include "profiles/registered_profiles.h"
#include "providers/joining.h"

namespace zmlr
{

namespace
{

// The sides of conforming_elements.
constexpr std::size_t profiles = 0;
constexpr std::size_t hosts = 1;
constexpr std::size_t object_managers = 2;
constexpr std::size_t subprofiles = 3;

struct Conforming
{
    const char* profile;
    std::size_t side;
};

constexpr Conforming conforming[] = {
    {"FC HBA", hosts}, {"Host Discovered Resources", hosts}, {"Storage HBA", hosts}, {"Server", object_managers}};

constexpr const char* standard = "SMI-S";

// False when the match is to end.
bool add_element(Joining& joining, ZEMLAR_RegisteredProfile* profile)
{
    for (const auto& [name, side] : conforming)
    {
        if (!profile->RegisteredName.value.equali(name) || !joining.ask(side))
            continue;
        Instance* element = joining[side][0];
        if (element)
            element->__name_space = "root/zemlar";
        return joining.pair(profiles, profile, side, element);
    }
    return true;
}

} // namespace

void conforming_elements(Joining& joining)
{
    const char* const log_source = joining.source();
    if (!joining.ask(profiles))
        return;
    Instance* standard_profile = nullptr;
    for (uint32 i = 0; i < joining[profiles].size(); i++)
    {
        auto* profile = joining.at<ZEMLAR_RegisteredProfile>(profiles, i);
        if (!profile)
            continue;
        const String& name = profile->RegisteredName.value;
        ZMLR_LOG(LL_INFO, "Building association instance for profile : %s", name.c_str());
        if (!add_element(joining, profile))
            return;
        if (name.equali(standard))
            standard_profile = profile;
    }
    if (!standard_profile)
    {
        ZMLR_LOG(LL_ERR, "No instances representing SMI-S standard is returned");
        return;
    }
    if (!joining.ask(subprofiles))
        return;
    for (Instance* subprofile : joining[subprofiles])
    {
        if (!joining.pair(profiles, standard_profile, subprofiles, subprofile))
            return;
    }
}

void required_subprofiles(Joining& joining)
{
    constexpr std::size_t parts = 1;
    if (!joining.ask_all())
        return;
    const Key_Index by_id = index_of(joining, parts);
    for (uint32 i = 0; i < joining[profiles].size(); i++)
    {
        auto* profile = joining.at<ZEMLAR_RegisteredProfile>(profiles, i);
        if (!profile)
            continue;
        for (const String& id : getSubProfilesOfProfile(profile->RegisteredName.value))
        {
            for (const uint32 part : by_id.at(id))
            {
                if (!joining.pair(profiles, profile, parts, joining[parts][part]))
                    return;
            }
        }
    }
}

} // namespace zmlr
