#include "inventory/provider_util.h"

#include "inventory/property_text.h"
#include "inventory/provider_init.h"
#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "ProviderUtil";

bool read_attributes(hxal_t* ioc, hxa_ioc_attr_t& attributes)
{
    attributes = {};
    return ioc && hxal_ioc_get_attr(ioc, &attributes) == HXA_STATUS_OK;
}

bool read_attributes(hxal_adapter_t* adapter, int ports, hxa_ioc_attr_t& attributes)
{
    for (int port = 0; port < ports; port++)
    {
        if (read_attributes(hxal_adapter_get_ethioc(adapter, port), attributes) ||
            read_attributes(hxal_adapter_get_fcioc(adapter, port), attributes))
            return true;
    }
    return false;
}

} // namespace

const ProviderUtil& ProviderUtil::getProviderUtil()
{
    static constinit const ProviderUtil util;
    return util;
}

String ProviderUtil::getClassName(classId_t id)
{
    const Scope_Trace trace(log_source);
    ZMLR_LOG(LL_INFO, "ClassId = %d", static_cast<int>(id));
    const char* name = class_name(id);
    if (!name)
    {
        ZMLR_LOG(LL_INFO, "ClassId is greater than MAXCLASSID");
        return "INVALID CLASS";
    }
    ZMLR_LOG(LL_INFO, "Class = %s", name);
    return name;
}

bool ProviderUtil::getDriverStatus()
{
    const Scope_Trace trace(log_source);
    const Driver_Status status = ProviderInit::getDriverStatus();
    return status == DRIVER_GOOD || status == DRIVER_FAILURE;
}

String ProviderUtil::getDriverVersion()
{
    const Scope_Trace trace(log_source);
    const int adapters = static_cast<int>(hxal_adapter_get_num());
    if (adapters == 0)
        ZMLR_LOG(LL_WARN, "No adapters in the system!");

    for (int index = 1; index <= adapters; index++)
    {
        hxal_adapter_t* adapter = hxal_adapter_open_idx(index);
        hxa_ioc_attr_t attributes;
        if (!adapter || !read_attributes(adapter, hxal_adapter_get_num_port(index), attributes))
            continue;

        char version[sizeof attributes.driver_attr.driver_ver];
        copy_text(version, attributes.driver_attr.driver_ver);
        trimString(version, version);
        return property_text(version);
    }
    return String();
}

} // namespace zmlr
