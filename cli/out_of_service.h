// Taking an element out of service for the time of a test.
#pragma once

#include "cli/host.h"
#include "cli/session.h"

#include <functional>
#include <string>

#include <signal.h>

namespace hxa
{

// While one exists the element is out of service; it comes back into service at the end, also after a failure and when somebody
// interrupts the program, which ends then. An element that was out of service before stays so, and nobody is asked.
class Out_Of_Service
{
public:
    Out_Of_Service(Session& session, const Adapter& adapter, const std::string& test);
    Out_Of_Service(Session& session, const Port& port, const std::string& test);
    Out_Of_Service(const Out_Of_Service&) = delete;
    Out_Of_Service& operator=(const Out_Of_Service&) = delete;
    ~Out_Of_Service();

private:
    void hold_signals();

    Session& _session;
    std::string _what;
    std::function<hxa_status_t()> _enable; // null: nothing to do
    sigset_t _signals{};
};

} // namespace hxa
