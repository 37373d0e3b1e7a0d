#include "hxal/internal/ioc_state.h"
#include "hxal/internal/request.h"

#include <chrono>
#include <thread>

namespace
{

using namespace std::chrono_literals;

constexpr int polls = 20;
constexpr auto pause_before_poll = 1s;

// The driver accepts at once and changes the state in its own time.
hxa_status_t wait_for_state(const hxal_s& ioc, hxa_ioc_state_t state)
{
    for (int poll = 0; poll < polls; ++poll)
    {
        std::this_thread::sleep_for(pause_before_poll);
        if (hxal::is_in_state(ioc, state))
            return HXA_STATUS_OK;
    }
    return HXA_STATUS_FAILED;
}

} // namespace

bool hxal::is_in_state(const hxal_s& ioc, hxa_ioc_state_t state)
{
    hxa_ioc_attr_t attr;
    return hxal_ioc_get_attr(&ioc, &attr) == HXA_STATUS_OK && attr.state == state;
}

hxa_status_t hxal_ioc_enable(const hxal_t* ioc)
{
    const hxa_status_t status = hxal::request(ioc, "IOCMD_IOC_ENABLE");
    return status == HXA_STATUS_OK ? wait_for_state(*ioc, HXA_IOC_OPERATIONAL) : status;
}

hxa_status_t hxal_ioc_disable(const hxal_t* ioc)
{
    const hxa_status_t status = hxal::request(ioc, "IOCMD_IOC_DISABLE");
    return status == HXA_STATUS_OK ? wait_for_state(*ioc, HXA_IOC_DISABLED) : status;
}
