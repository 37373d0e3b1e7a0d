#include "inventory/beacon.h"

#include "inventory/adapter_lookup.h"
#include "inventory/adapter_walk.h"
#include "inventory/cim_values.h"
#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "PortHelper";

Beacon_Result result_of(hxa_status_t status)
{
    ZMLR_LOG(LL_INFO, "setAlarmState returned : %d", static_cast<int>(status));
    switch (status)
    {
    case HXA_STATUS_FAILED:
        ZMLR_LOG(LL_ERR, "setAlarmState failed");
        return BEACON_FAILED;
    case HXA_STATUS_BEACON_ON:
    case HXA_STATUS_BEACON_OFF:
        ZMLR_LOG(LL_WARN, "setAlarmState : State already set");
        return BEACON_ALREADY_SO;
    default:
        ZMLR_LOG(LL_INFO, "setAlarmState success");
        return BEACON_DONE;
    }
}

} // namespace

Beacon_Result setAlarmState(const String& port_wwn, int state)
{
    const Scope_Trace trace(log_source);
    const Ioc_Handle ioc(ProviderUtil::getHxalHandlerByPortWWN(port_wwn));
    if (!ioc)
    {
        ZMLR_LOG(LL_ERR, "hxal handler is NULL.");
        return BEACON_FAILED;
    }
    hxa_ioc_attr_t attributes = {};
    if (hxal_ioc_get_attr(ioc.get(), &attributes) != HXA_STATUS_OK)
    {
        ZMLR_LOG(LL_ERR, "hxal_ioc_get_attr failed.");
        return BEACON_FAILED;
    }
    if (attributes.adapter_attr.is_mezz)
    {
        ZMLR_LOG(LL_WARN, "setAlarmState: Operation not supported on Mezz cards");
        return BEACON_NOT_SUPPORTED;
    }
    const hxa_boolean_t on = state == ALARM_STATE_ALTERNATING ? HXA_TRUE : HXA_FALSE;
    return result_of(hxal_diag_beacon_lport(ioc.get(), on, 0));
}

} // namespace zmlr
