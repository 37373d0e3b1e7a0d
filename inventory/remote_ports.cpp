#include "inventory/remote_ports.h"

#include <algorithm>

namespace zmlr
{

Remote_Ports::Remote_Ports(const hxal_t* ioc, wwn_t port_wwn, const char* log_source, Log_Level level)
{
    std::uint32_t count = _room;
    const hxa_status_t status = hxal_lport_get_rports(ioc, base_fabric, port_wwn, _wwns.data(), &count);
    if (status != HXA_STATUS_OK)
    {
        ZMLR_LOG(LL_ERR, "hxal_lport_get_rports returned error -  %d", static_cast<int>(status));
        return;
    }
    ZMLR_LOG(level, "hxal_lport_get_rports. Number of rports -  %d", static_cast<int>(count));
    _count = std::min(count, _room);
}

} // namespace zmlr
