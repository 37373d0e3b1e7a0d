// The simulated host at work: its IOCs by driver instance, and the state that requests read and change.
#pragma once

#include "sim/model/adapter.h"
#include "sim/model/event_log.h"
#include "sim/model/node.h"

#include "hxal/records/iocfc.h"

#include <array>
#include <map>
#include <string>
#include <utility>
#include <vector>

namespace hxasim
{

// One I/O controller: one PCI function, seen by one driver.
struct Ioc
{
    Node node;
    std::uint32_t type; // hxa_ioc_type_e
    std::uint32_t instance;
    Adapter* adapter;
    Port* port;
    std::uint8_t port_number;   // on its adapter
    std::uint32_t pci_function; // FC functions first, then the Ethernet functions
    std::uint32_t* state;       // hxa_ioc_state_t

    // What its driver keeps of it: the names are those of one driver, the other one has its own.
    std::string adapter_name = {};
    std::string port_name = {};
    hxa_iocfc_intr_attr_t interrupts{};
    hxa_ioc_stats_t stats{};
    hxa_iocfc_stats_t fc_stats{};
    std::map<std::uint32_t, std::uint32_t> registers = {}; // by offset; the others hold 0
    std::uint32_t next_state = 0;                          // the state it is on the way to ...
    std::uint32_t settle = 0;                              // ... and how many attribute requests will see it there
    Event_Log events{};
};

class Host
{
public:
    Host(const std::array<Driver, 2>& drivers, std::vector<Adapter> adapters);
    Host(const Host&) = delete;
    Host& operator=(const Host&) = delete;

    const Driver& driver(Node node) const { return _drivers[static_cast<std::size_t>(node)]; }
    const std::vector<Ioc>& iocs(Node node) const { return _iocs[static_cast<std::size_t>(node)]; }
    std::vector<Ioc>& iocs(Node node) { return _iocs[static_cast<std::size_t>(node)]; }
    const std::vector<Adapter>& adapters() const { return _adapters; }
    std::vector<Adapter>& adapters() { return _adapters; }

    Ioc* find(Node node, std::uint32_t instance); // null when there is none; also one whose card is not plugged

    // Queues an event of this IOC for every application. A driver that is not there says nothing.
    void raise(Ioc& ioc, hxa_aen_entry_t event);

    // Whether there are other events to fetch than when this was asked the last time.
    bool take_event_news() { return std::exchange(_event_news, false); }
    void tell_event_news() { _event_news = true; }

    // A driver keeps one name for a card, whichever of its IOCs is told.
    void name_adapter(const Ioc& told, const std::string& name);

private:
    void add(Ioc ioc);
    void add_port(Adapter& adapter, std::uint8_t number);

    std::array<Driver, 2> _drivers; // by Node
    std::vector<Adapter> _adapters;
    std::array<std::vector<Ioc>, 2> _iocs; // in the order of the scenario
    bool _event_news = false;
};

inline bool is_fibre_channel(const Ioc& ioc) { return ioc.type != HXA_IOC_TYPE_LL; }
inline const Mac& mac_of(const Ioc& ioc) { return is_fibre_channel(ioc) ? ioc.port->fcoe_mac : ioc.port->mac; }

// Whether a number is the speed of a link (hxa_pport_speed_t), and none that is still to be found.
bool is_link_speed(std::uint32_t speed);

// Whether the port can be told to run at a speed: one that it has, or the best that there is.
bool can_run_at(const Port& port, std::uint32_t speed);

// The port's own state on the side of this IOC.
std::uint32_t& own_state(const Ioc& ioc);

// Whether a port in this state was put out of service.
bool is_out_of_service(std::uint32_t state);

// What the port reports through this IOC: its own state while the IOC runs, else that the IOC is down.
std::uint32_t port_state(const Ioc& ioc);

} // namespace hxasim
