// The method, association and indication interfaces of an adapter: their life, and one answer to all requests.
#include "cmpi/request.h"

namespace zmlr
{

namespace
{

template <class MI> CMPIStatus not_supported(const char* name, MI* mi, const CMPIContext* context) noexcept
{
    return serve(name, mi, context, [](CMPI_Adapter&) { return CMPI_RC_ERR_NOT_SUPPORTED; });
}

} // namespace

CMPIStatus CMPI_Adapter::methodCleanup(CMPIMethodMI* mi, const CMPIContext* context, CMPIBoolean terminating) noexcept
{
    return serve_cleanup("methodCleanup", mi, context, terminating);
}

CMPIStatus CMPI_Adapter::invokeMethod(CMPIMethodMI* mi, const CMPIContext* context, const CMPIResult*, const CMPIObjectPath*,
                                      const char*, const CMPIArgs*, CMPIArgs*) noexcept
{
    return not_supported("invokeMethod", mi, context);
}

// The one cleanup that runs without a thread context.
CMPIStatus CMPI_Adapter::associationCleanup(CMPIAssociationMI* mi, const CMPIContext*, CMPIBoolean terminating) noexcept
{
    constexpr const char* name = "associationCleanup";
    return {shielded(name, [&] { return traced_cleanup(name, CMPI_Adapter::of(mi), terminating); }), nullptr};
}

CMPIStatus CMPI_Adapter::associators(CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult*, const CMPIObjectPath*,
                                     const char*, const char*, const char*, const char*, const char**) noexcept
{
    return not_supported("associators", mi, context);
}

CMPIStatus CMPI_Adapter::associatorNames(CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult*,
                                         const CMPIObjectPath*, const char*, const char*, const char*, const char*) noexcept
{
    return not_supported("associatorNames", mi, context);
}

CMPIStatus CMPI_Adapter::references(CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult*, const CMPIObjectPath*,
                                    const char*, const char*, const char**) noexcept
{
    return not_supported("references", mi, context);
}

CMPIStatus CMPI_Adapter::referenceNames(CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult*,
                                        const CMPIObjectPath*, const char*, const char*) noexcept
{
    return not_supported("referenceNames", mi, context);
}

CMPIStatus CMPI_Adapter::indicationCleanup(CMPIIndicationMI* mi, const CMPIContext* context, CMPIBoolean terminating) noexcept
{
    return serve_cleanup("indicationCleanup", mi, context, terminating);
}

CMPIStatus CMPI_Adapter::authorizeFilter(CMPIIndicationMI* mi, const CMPIContext* context, const CMPISelectExp*, const char*,
                                         const CMPIObjectPath*, const char*) noexcept
{
    return not_supported("authorizeFilter", mi, context);
}

CMPIStatus CMPI_Adapter::mustPoll(CMPIIndicationMI* mi, const CMPIContext* context, const CMPISelectExp*, const char*,
                                  const CMPIObjectPath*) noexcept
{
    return not_supported("mustPoll", mi, context);
}

CMPIStatus CMPI_Adapter::activateFilter(CMPIIndicationMI* mi, const CMPIContext* context, const CMPISelectExp*, const char*,
                                        const CMPIObjectPath*, CMPIBoolean) noexcept
{
    return not_supported("activateFilter", mi, context);
}

CMPIStatus CMPI_Adapter::deactivateFilter(CMPIIndicationMI* mi, const CMPIContext* context, const CMPISelectExp*, const char*,
                                          const CMPIObjectPath*, CMPIBoolean) noexcept
{
    return not_supported("deactivateFilter", mi, context);
}

CMPIStatus CMPI_Adapter::enableIndications(CMPIIndicationMI* mi, const CMPIContext* context) noexcept
{
    return not_supported("enableIndications", mi, context);
}

CMPIStatus CMPI_Adapter::disableIndications(CMPIIndicationMI* mi, const CMPIContext* context) noexcept
{
    return not_supported("disableIndications", mi, context);
}

} // namespace zmlr
