// IndicationHelper: from the drivers' events to the alerts that wait to be delivered.
#pragma once

#include "runtime/instance.h"
#include "schema/ZEMLAR_AlertIndication.h"

namespace zmlr
{

// One object. Alerts come and go on any thread; whoever subscribes and unsubscribes takes turns, and neither subscribes twice nor
// holds a lock that the making of an alert takes.
class IndicationHelper
{
public:
    static IndicationHelper& getIndicationHelperInstance();

    // From now on events become alerts, until it is unsubscribed. False, and nothing stays registered, when there is no adapter
    // or the events' thread cannot be started.
    bool subscribeForEventNotifications();

    // When it returns no event becomes an alert any more; those that wait stay. False when something remained registered.
    bool unsubscribeForEventNotifications();

    bool getIndicationObject(Ref<ZEMLAR_AlertIndication>& out); // the oldest alert; false when none waits
    bool updateIndicationObjects(Ref<ZEMLAR_AlertIndication> alert);
    void releaseIndicationObjects(); // all that wait
};

} // namespace zmlr
