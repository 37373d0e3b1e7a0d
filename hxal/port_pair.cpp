#include "hxal/adapter.h"
#include "hxal/diag.h"
#include "hxal/fcoe.h"
#include "hxal/port.h"

#include <optional>

namespace
{

// The two functions of one port of a card; at least one is there.
struct Port_Pair
{
    const hxal_t* fc;
    const hxal_t* ethernet;
};

std::optional<Port_Pair> pair_of(const hxal_s& ioc)
{
    const auto index = static_cast<int>(hxal_adapter_get_idx_by_hwpath(ioc.adapter_hwpath));
    const hxal_adapter_t* adapter = hxal_adapter_open_idx(index);
    const Port_Pair pair{.fc = hxal_adapter_get_fcioc(adapter, ioc.port_num),
                         .ethernet = hxal_adapter_get_ethioc(adapter, ioc.port_num)};
    return pair.fc || pair.ethernet ? std::optional(pair) : std::nullopt;
}

hxa_status_t each(const Port_Pair& pair, hxa_status_t (*operation)(const hxal_t*))
{
    const hxa_status_t fc = pair.fc ? operation(pair.fc) : HXA_STATUS_OK;
    const hxa_status_t ethernet = pair.ethernet ? operation(pair.ethernet) : HXA_STATUS_OK;
    return fc != HXA_STATUS_OK ? fc : ethernet;
}

} // namespace

hxa_status_t hxal_port_enable(const hxal_t* ioc)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    const auto pair = pair_of(*ioc);
    if (!pair)
        return HXA_STATUS_FAILED;
    for (const hxal_t* side : {pair->fc, pair->ethernet})
        if (const hxa_status_t held = side ? hxal_diag_get_lb_status(side) : HXA_STATUS_OK; held != HXA_STATUS_OK)
            return held;
    return each(*pair, hxal_fcoe_port_enable);
}

hxa_status_t hxal_port_disable(const hxal_t* ioc)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    const auto pair = pair_of(*ioc);
    return pair ? each(*pair, hxal_fcoe_port_disable) : HXA_STATUS_FAILED;
}
