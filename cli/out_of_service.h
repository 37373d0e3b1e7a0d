// Taking an element out of service for the time of a test.
#pragma once

#include "cli/host.h"
#include "cli/session.h"

#include <string>
#include <vector>

#include <signal.h>

namespace hxa
{

// While one exists the element is out of service. What of it was in service before comes back at the end, also after a failure
// and when somebody interrupts the program, which ends then. Asks first, unless nothing of it was in service.
class Out_Of_Service
{
public:
    Out_Of_Service(Session& session, const Adapter& adapter, const std::string& test); // its IOCs
    Out_Of_Service(Session& session, const Port& port, const std::string& test);       // its functions
    Out_Of_Service(const Out_Of_Service&) = delete;
    Out_Of_Service& operator=(const Out_Of_Service&) = delete;
    ~Out_Of_Service();

private:
    using Request = hxa_status_t (*)(const hxal_t*);

    // Asks with the question, then sends `disable` to each of the IOCs.
    void take(const std::string& question, Request disable);

    Session& _session;
    std::string _what;
    Request _enable;
    std::vector<const hxal_t*> _in_service;
    sigset_t _signals{};
};

} // namespace hxa
