#include "indications/pending_alerts.h"

#include "runtime/log.h"

#include <utility>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "IndicationHelper";

} // namespace

Ref<ZEMLAR_AlertIndication> Pending_Alerts::pop()
{
    Ref<ZEMLAR_AlertIndication> oldest(_ring[_first]);
    _first = (_first + 1) % most;
    --_size;
    return oldest;
}

void Pending_Alerts::append(Ref<ZEMLAR_AlertIndication> alert)
{
    Ref<ZEMLAR_AlertIndication> dropped;
    bool tell = false;
    {
        const std::lock_guard lock(_mutex);
        if (_size == most)
        {
            dropped = pop();
            tell = !std::exchange(_overflow_told, true);
        }
        _ring[(_first + _size) % most] = alert.steal();
        ++_size;
    }
    if (tell)
        ZMLR_LOG(LL_WARN, "More than %zu alerts wait to be delivered: the oldest are dropped", most);
}

Ref<ZEMLAR_AlertIndication> Pending_Alerts::take()
{
    const std::lock_guard lock(_mutex);
    if (_size == 0)
        return {};
    Ref<ZEMLAR_AlertIndication> oldest = pop();
    if (_size <= most / 2)
        _overflow_told = false;
    return oldest;
}

void Pending_Alerts::clear()
{
    while (take())
        continue;
}

} // namespace zmlr
