#include "indications/indication_manager.h"

#include "inventory/provider_util.h"
#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "IndicationManager";

[[maybe_unused]] const IndicationManager& made_at_load = IndicationManager::getIndicationManager();

} // namespace

IndicationManager::IndicationManager() : _helper(&IndicationHelper::getIndicationHelperInstance())
{
    ZMLR_LOG(LL_DBG, "Inside IndicationManager Constructor");
}

const IndicationManager& IndicationManager::getIndicationManager()
{
    static const IndicationManager manager;
    return manager;
}

bool IndicationManager::subscribeForEventNotifications() const
{
    const Scope_Trace trace(log_source);
    if (ProviderUtil::getDriverStatus())
        return _helper->subscribeForEventNotifications();
    ZMLR_LOG(LL_ERR, "Driver is not installed or there is a hxal mismatch. Will not invoke subscription. ");
    return false;
}

bool IndicationManager::unsubscribeForEventNotifications() const
{
    const Scope_Trace trace(log_source);
    return _helper->unsubscribeForEventNotifications();
}

bool IndicationManager::getIndicationObject(Ref<ZEMLAR_AlertIndication>& out) const { return _helper->getIndicationObject(out); }

void IndicationManager::releaseIndicationObjects() const { _helper->releaseIndicationObjects(); }

} // namespace zmlr
