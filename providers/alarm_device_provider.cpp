#include "inventory/beacon.h"
#include "inventory/cim_values.h"
#include "providers/ZEMLAR_AlarmDevice_Provider_Skeleton.h"
#include "providers/enumerating_provider.h"
#include "runtime/log.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "ZEMLAR_AlarmDevice_Provider";

// What the method returns, for each result of switching the beacon.
uint32 code_of(Beacon_Result result)
{
    switch (result)
    {
    case BEACON_DONE:
        return 0;
    case BEACON_NOT_SUPPORTED:
        return 1;
    default:
        return 2;
    }
}

bool is_settable(const Property<uint16>& state)
{
    return !state.null && (state.value == ALARM_STATE_OFF || state.value == ALARM_STATE_ALTERNATING);
}

class ZEMLAR_AlarmDevice_Provider final : public Enumerating_Provider<ZEMLAR_AlarmDevice_Provider_Skeleton>
{
public:
    ZEMLAR_AlarmDevice_Provider() : Enumerating_Provider(log_source) {}

    Invoke_Method_Status SetAlarmState(const ZEMLAR_AlarmDevice* self, const Property<uint16>& State,
                                       Property<uint32>& return_value) override
    {
        const Scope_Trace trace(log_source, "SetAlarmState");
        if (is_settable(State))
            return_value.set(code_of(setAlarmState(self->DeviceID.value, State.value)));
        else
        {
            ZMLR_LOG(LL_ERR, "Error: Invalid Input State");
            return_value.set(2);
        }
        ZMLR_LOG(LL_INFO, "return value = %d\n", static_cast<int>(return_value.value));
        return INVOKE_METHOD_OK;
    }
};

} // namespace

ZEMLAR_AlarmDevice_Provider_Skeleton* create_ZEMLAR_AlarmDevice_Provider() { return new ZEMLAR_AlarmDevice_Provider; }

} // namespace zmlr
