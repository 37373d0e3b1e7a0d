// What is registered with the access library for its events, and the library's event thread.
#pragma once

#include "hxal/aen.h"
#include "inventory/adapter_walk.h"
#include "runtime/string.h"

#include <vector>

namespace zmlr
{

// For one thread at a time.
class Event_Registrations
{
public:
    // Registers for the events of every adapter and port, throws away what the drivers have queued up to now (one fetch for each
    // IOC), and starts the event thread, which may raise events at once. An object that cannot be registered is logged and left
    // out. False, with nothing registered, when there is no adapter or the event thread does not start; the same when it throws.
    bool registerForEvents();

    // Ends the event thread and unregisters everything: no callback runs from then on. False when an object could not be
    // unregistered. Whoever calls it holds no lock that a callback takes.
    bool deRegisterForEvents();

private:
    // One registration, by the text of its object. Two cards may share a serial number, and two ports a WWN.
    template <class Handle> struct Registered
    {
        String object;
        Handle* handle;
    };
    template <class Handle> using List = std::vector<Registered<Handle>>;

    bool register_all();
    void register_added_adapters();
    void register_adapter(const Open_Adapter& adapter);
    void register_port(const Open_Port& port);
    void register_ethernet_port(const hxal_t* ioc);
    void register_fc_port(const hxal_t* ioc);
    bool unregister_all();

    List<hxal_adapter_aen_cbhandle_t> _adapters;
    List<hxal_port_aen_cbhandle_t> _ports;
    List<hxal_ethport_aen_cbhandle_t> _ethernet_ports;
    List<hxal_audit_aen_cbhandle_t> _audits;
};

} // namespace zmlr
