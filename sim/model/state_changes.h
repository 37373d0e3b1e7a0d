// What happens to a host at work, and what its drivers say about it: links that come and go, cards that are pulled and put
// back. Whatever changes the state of a function compares before and after, so that no change goes untold.
#pragma once

#include "sim/model/host.h"

namespace hxasim
{

// One function of a port as its driver sees it.
struct Function_State
{
    std::uint32_t ioc;  // hxa_ioc_state_t
    std::uint32_t port; // hxa_pport_states_t, whatever the IOC does
    bool link_up;
};

Function_State function_state(const Ioc& ioc);

// The function has come from `before` to where it is now: raises the events of that, and logs its logical ports into the
// fabric or out of it. A link that has come up runs with what was configured meanwhile.
void follow(Host& host, Ioc& ioc, const Function_State& before);

// A driver has found a remote port, or lost it, and with it the nexus to a target.
void tell_remote_port(Host& host, Ioc& ioc, const Logical_Port& logical, const Remote_Port& remote, bool on_line);

// The link behind both functions of a port. One that is out of service follows when it goes into service.
// Throws std::runtime_error without a module in the cage.
void set_link(Host& host, const Port& port, bool up);

// The module in the cage of a port; its link goes with it, but not up on one that the driver does not support. Throws
// std::runtime_error when there is nothing to do.
void set_sfp(Host& host, const Port& port, bool inserted);

// Pulls a card out, or puts it back as it was. Its IOCs are gone meanwhile; the events they raised before can still be
// fetched. Throws std::runtime_error when there is nothing to do.
void set_plugged(Host& host, Adapter& adapter, bool plugged);

} // namespace hxasim
