#include "cli/out_of_service.h"

#include "hxal/ethport.h"
#include "hxal/fcoe.h"
#include "hxal/port.h"

namespace hxa
{

namespace
{

bool is_out(std::uint32_t state) { return state == HXA_PPORT_ST_DISABLED || state == HXA_PPORT_ST_PREBOOT_DISABLED; }

// Whether the function of a port, or the IOC, tells that it is disabled.
bool is_function_disabled(const hxal_t* ioc)
{
    if (ioc->ioc_type == HXA_IOC_TYPE_LL)
    {
        hxa_ethport_attr_t attr{};
        return hxal_ethport_get_attr(ioc, &attr) == HXA_STATUS_OK && is_out(attr.port_state);
    }
    hxa_pport_attr_t attr{};
    return hxal_port_get_attr(ioc, &attr) == HXA_STATUS_OK && is_out(attr.port_state);
}

bool is_ioc_disabled(const hxal_t* ioc)
{
    hxa_ioc_attr_t attr{};
    return hxal_ioc_get_attr(ioc, &attr) == HXA_STATUS_OK && attr.state == HXA_IOC_DISABLED;
}

std::vector<const hxal_t*> in_service(const Port& port, bool (*is_disabled)(const hxal_t*))
{
    std::vector<const hxal_t*> iocs;
    for (const auto* ioc : {port.fc, port.ethernet})
        if (ioc && !is_disabled(ioc))
            iocs.push_back(ioc);
    return iocs;
}

} // namespace

Out_Of_Service::Out_Of_Service(Session& session, const Adapter& adapter, const std::string& test)
    : _session(session)
    , _what("adapter " + adapter.name())
    , _enable(hxal_ioc_enable)
{
    for (const auto& port : ports_of(adapter))
        for (const auto* ioc : in_service(port, is_ioc_disabled))
            _in_service.push_back(ioc);
    take("For the " + test + " adapter " + adapter.name() + " stops, and its ports lose their links until it is done.",
         hxal_ioc_disable);
}

Out_Of_Service::Out_Of_Service(Session& session, const Port& port, const std::string& test)
    : _session(session)
    , _what("port " + port.name())
    , _enable(hxal_fcoe_port_enable)
    , _in_service(in_service(port, is_function_disabled))
{
    take("For the " + test + " port " + port.name() + " goes out of service until it is done.", hxal_fcoe_port_disable);
}

Out_Of_Service::~Out_Of_Service()
{
    for (const auto* ioc : _in_service)
        _session.accept(_enable(ioc), _what + " does not come back into service");
    if (!_in_service.empty())
        pthread_sigmask(SIG_SETMASK, &_signals, nullptr);
}

void Out_Of_Service::take(const std::string& question, Request disable)
{
    if (_in_service.empty())
        return;
    _session.confirm(question);
    sigset_t held;
    sigemptyset(&held);
    for (const int signal : {SIGINT, SIGTERM, SIGHUP, SIGQUIT})
        sigaddset(&held, signal);
    pthread_sigmask(SIG_BLOCK, &held, &_signals);
    for (const auto* ioc : _in_service)
        _session.accept(disable(ioc), _what + " does not go out of service");
}

} // namespace hxa
