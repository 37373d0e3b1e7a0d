#include "cli/out_of_service.h"

#include "hxal/ethport.h"
#include "hxal/port.h"

namespace hxa
{

namespace
{

bool is_out(std::uint32_t state) { return state == HXA_PPORT_ST_DISABLED || state == HXA_PPORT_ST_PREBOOT_DISABLED; }

// Whether each function of the port tells that it is disabled.
bool is_disabled(const Port& port)
{
    hxa_pport_attr_t fc{};
    hxa_ethport_attr_t ethernet{};
    return (!port.fc || (hxal_port_get_attr(port.fc, &fc) == HXA_STATUS_OK && is_out(fc.port_state))) &&
           (!port.ethernet || (hxal_ethport_get_attr(port.ethernet, &ethernet) == HXA_STATUS_OK && is_out(ethernet.port_state)));
}

} // namespace

Out_Of_Service::Out_Of_Service(Session& session, const Adapter& adapter, const std::string& test)
    : _session(session)
    , _what("adapter " + adapter.name())
{
    if (hxal_adapter_is_disabled(adapter.number))
        return;
    session.confirm("For the " + test + " adapter " + adapter.name() +
                    " stops, and its ports lose their links until it is done.");
    hold_signals();
    _enable = [number = adapter.number] { return hxal_adapter_enable(number); };
    const auto status = hxal_adapter_disable(adapter.number);
    if (status != HXA_STATUS_OK)
        session.accept(status, _what);
}

Out_Of_Service::Out_Of_Service(Session& session, const Port& port, const std::string& test)
    : _session(session)
    , _what("port " + port.name())
{
    if (is_disabled(port))
        return;
    session.confirm("For the " + test + " port " + port.name() + " goes out of service until it is done.");
    hold_signals();
    _enable = [ioc = port.ioc()] { return hxal_port_enable(ioc); };
    const auto status = hxal_port_disable(port.ioc());
    if (status != HXA_STATUS_OK)
        session.accept(status, _what);
}

Out_Of_Service::~Out_Of_Service()
{
    if (!_enable)
        return;
    _session.accept(_enable(), _what + " does not come back into service");
    pthread_sigmask(SIG_SETMASK, &_signals, nullptr);
}

void Out_Of_Service::hold_signals()
{
    sigset_t held;
    sigemptyset(&held);
    for (const int signal : {SIGINT, SIGTERM, SIGHUP, SIGQUIT})
        sigaddset(&held, signal);
    pthread_sigmask(SIG_BLOCK, &held, &_signals);
}

} // namespace hxa
