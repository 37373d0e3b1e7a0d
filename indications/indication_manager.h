// IndicationManager: the way from the alert provider to the IndicationHelper.
#pragma once

#include "indications/indication_helper.h"

namespace zmlr
{

// One object, made when the module is loaded. Its operations are those of the IndicationHelper.
class IndicationManager
{
public:
    static const IndicationManager& getIndicationManager();

    bool subscribeForEventNotifications() const; // false too when the driver gate is closed
    bool unsubscribeForEventNotifications() const;
    bool getIndicationObject(Ref<ZEMLAR_AlertIndication>& out) const;
    void releaseIndicationObjects() const;

private:
    IndicationManager();

    IndicationHelper* const _helper;
};

} // namespace zmlr
