#include "indications/indication_helper.h"

#include "indications/event_index.h"
#include "indications/event_registrations.h"
#include "indications/pending_alerts.h"
#include "runtime/log.h"
#include "runtime/trace.h"

#include <type_traits>
#include <utility>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "IndicationHelper";

constinit Pending_Alerts pending;
static_assert(std::is_trivially_destructible_v<Pending_Alerts>, "the delivery thread may outlive all static objects");

Event_Registrations registrations;

} // namespace

IndicationHelper& IndicationHelper::getIndicationHelperInstance()
{
    static constinit IndicationHelper helper;
    return helper;
}

bool IndicationHelper::subscribeForEventNotifications()
{
    const Scope_Trace trace(log_source);
    if (!registrations.registerForEvents())
        return false;
    const bool indexed = initEventIndex();
    ZMLR_LOG(LL_DBG, "initEventIndex() method returned %d.", static_cast<int>(indexed));
    return true;
}

bool IndicationHelper::unsubscribeForEventNotifications()
{
    const Scope_Trace trace(log_source);
    return registrations.deRegisterForEvents();
}

bool IndicationHelper::getIndicationObject(Ref<ZEMLAR_AlertIndication>& out)
{
    out = pending.take();
    return static_cast<bool>(out);
}

bool IndicationHelper::updateIndicationObjects(Ref<ZEMLAR_AlertIndication> alert)
{
    const Scope_Trace trace(log_source);
    pending.append(std::move(alert));
    return true;
}

void IndicationHelper::releaseIndicationObjects() { pending.clear(); }

} // namespace zmlr
