#include "inventory/cim_values.h"
#include "inventory/fchba_manager.h"
#include "inventory/provider_util.h"
#include "inventory/software_update_helper.h"
#include "inventory/tftp.h"
#include "providers/ZEMLAR_HBASoftwareInstallationService_Provider_Skeleton.h"
#include "providers/enumerating_provider.h"
#include "runtime/log.h"
#include "schema/CIM_ManagedElement.h"

#include <cstring>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "ZEMLAR_HBASoftwareInstallationService_Provider";

// What CIM_SoftwareInstallationService.InstallFromURI returns.
constexpr uint32 COMPLETED = 0;
constexpr uint32 FAILED = 2;

// Why an installation ended; null while nothing is wrong.
using Error = const char*;

Error refuse(const char* line, Error error)
{
    ZMLR_LOG(LL_ERR, "%s", line);
    return error;
}

Error check(const Property<String>& uri, const CIM_ManagedElement* target, const Property<Array<uint16>>& options)
{
    constexpr Error empty = "empty input parameters";
    if (uri.null || uri.value.empty())
        return refuse("URI.value is empty", empty);
    if (!target)
        return refuse("Target is empty", empty);
    if (options.null || options.value.empty())
        return refuse("InstallOptions.value.size() is  0", empty);
    if (options.value[0] != INSTALL_OPTION_INSTALL && options.value[0] != INSTALL_OPTION_UPDATE)
        return refuse("InstallOptions[0] validation failed. throw invalide option type", "invalid option type");
    return nullptr;
}

Error use_local_file(const String& path)
{
    ZMLR_LOG(LL_INFO, "file=%s", path.c_str());
    return path.empty() ? "malformed file URI" : nullptr;
}

Error fetch(const String& text, Fetched_File& file)
{
    const std::optional<Tftp_Address> address = parse_tftp_address(text);
    if (!address)
        return "malformed tftp URI";
    if (ProviderUtil::TftpGetFile(address->server.c_str(), address->file.c_str()) != 0)
        return "tftp command failed";
    file.name = address->file;
    return nullptr;
}

// Finds the file that the URI names, fetching it first when it is elsewhere.
Error find_file(const String& uri, Fetched_File& fetched, String& path)
{
    constexpr uint32 scheme_size = 7;
    const auto has_scheme = [&](const char* scheme) { return std::strncmp(uri.c_str(), scheme, scheme_size) == 0; };
    Error error = nullptr;
    if (has_scheme("file://"))
    {
        path = uri.substr(scheme_size);
        error = use_local_file(path);
    }
    else if (has_scheme("tftp://"))
    {
        error = fetch(uri.substr(scheme_size), fetched);
        path = fetched.name;
    }
    else
        error = refuse("malformed uri. Throw error", "malformed URI");
    if (error)
        return error;
    return ProviderUtil::IsFileExist(path.c_str()) ? nullptr : refuse("File doesnt exist", "File not exists");
}

Error update(const Instance* target, const char* file)
{
    const Instance_Array controllers = FCHBAManager::getFCHBAManager().getInstances(CLASSID_PortController);
    for (Instance* instance : controllers)
    {
        // The controller comes first: its keys are asked for, so that a target without keys is none of them.
        const auto* controller = cast<ZEMLAR_PortController>(instance);
        if (!controller || !key_eq(controller, target))
            continue;
        const SoftwareUpdateHelper& helper = SoftwareUpdateHelper::getSoftwareUpdateHelperInstance();
        if (helper.UpdatePortControllerSoftware(*controller, file) == 0)
            return nullptr;
        return refuse("UpdatePortControllerSoftware method failed", "controller update failed");
    }
    return refuse("Couldnt find the matching port controller.", "Could not find target controller");
}

class ZEMLAR_HBASoftwareInstallationService_Provider final
    : public Enumerating_Provider<ZEMLAR_HBASoftwareInstallationService_Provider_Skeleton>
{
public:
    ZEMLAR_HBASoftwareInstallationService_Provider() : Enumerating_Provider(log_source) {}

    // Installations run one after the other: the adapter's lock is held for the whole request.
    Invoke_Method_Status InstallFromURI(const ZEMLAR_HBASoftwareInstallationService*, CIM_ConcreteJob*&,
                                        const Property<String>& URI, const CIM_ManagedElement* Target,
                                        const Property<Array<uint16>>& InstallOptions, const Property<Array<String>>&,
                                        Property<uint32>& return_value) override
    {
        const Scope_Trace trace(log_source, "InstallFromURI");
        const Error error = install(URI, Target, InstallOptions);
        if (error)
            ZMLR_LOG(LL_ERR, "InstallFromURI : ERROR - %s", error);
        else
            ZMLR_LOG(LL_INFO, "Software update is success");
        return_value.set(error ? FAILED : COMPLETED);
        ZMLR_LOG(LL_INFO, "return value = %d\n", static_cast<int>(return_value.value));
        return INVOKE_METHOD_OK;
    }

private:
    // Whatever fails is told by the return value.
    static Error install(const Property<String>& uri, const CIM_ManagedElement* target, const Property<Array<uint16>>& options)
    try
    {
        Fetched_File fetched;
        String path;
        Error error = check(uri, target, options);
        if (!error)
            error = find_file(uri.value, fetched, path);
        return error ? error : update(target, path.c_str());
    }
    catch (...)
    {
        return "unknown Exception";
    }
};

} // namespace

ZEMLAR_HBASoftwareInstallationService_Provider_Skeleton* create_ZEMLAR_HBASoftwareInstallationService_Provider()
{
    return new ZEMLAR_HBASoftwareInstallationService_Provider;
}

} // namespace zmlr
