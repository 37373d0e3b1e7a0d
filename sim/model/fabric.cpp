#include "sim/model/fabric.h"

namespace hxasim
{

void log_in(Remote_Port& port)
{
    if (port.state != HXA_RPORT_ONLINE)
        return;
    ++port.counters->plogis;
    ++port.counters->plogi_accs;
    ++port.counters->onlines;
    if (!port.is_target())
        return;
    ++port.nexus.counters->prli_sent;
    ++port.nexus.counters->prli_rsp_acc;
    ++port.nexus.counters->onlines;
}

void log_out(Remote_Port& port)
{
    if (port.state != HXA_RPORT_ONLINE)
        return;
    ++port.counters->offlines;
    if (port.is_target())
        ++port.nexus.counters->offlines;
}

void log_in(Logical_Port& port)
{
    ++port.counters->ns_plogi_sent;
    ++port.counters->ns_plogi_accepts;
    ++port.counters->ns_gidft_sent;
    ++port.counters->ns_gidft_accepts;
    for (auto& remote : port.remote_ports)
        if (remote.known)
            log_in(remote);
}

void log_out(Logical_Port& port)
{
    for (auto& remote : port.remote_ports)
        if (remote.known)
            log_out(remote);
}

} // namespace hxasim
