#include "cli/commands.h"
#include "cli/event_tree.h"
#include "cli/host.h"

#include <poll.h>
#include <signal.h>
#include <sys/eventfd.h>
#include <sys/signalfd.h>
#include <unistd.h>

#include <deque>
#include <mutex>
#include <utility>

namespace hxa
{

namespace
{

// Events on their way from the library's thread to the one that prints them.
class Queue
{
public:
    Queue() : _arrival(eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK)) {}
    Queue(const Queue&) = delete;
    Queue& operator=(const Queue&) = delete;
    ~Queue() { close(_arrival); }

    int descriptor() const { return _arrival; } // readable while there are events

    void put(Value event)
    {
        const std::lock_guard lock(_mutex);
        _events.push_back(std::move(event));
        eventfd_write(_arrival, 1);
    }

    std::deque<Value> take()
    {
        const std::lock_guard lock(_mutex);
        eventfd_t count;
        eventfd_read(_arrival, &count);
        return std::exchange(_events, {});
    }

private:
    const int _arrival;
    std::mutex _mutex;
    std::deque<Value> _events;
};

// What a registration calls back with.
struct Listener
{
    Queue& queue;
    Event_Source source;
    const hxal_t* ioc; // null: an adapter's
};

// The events of an IOC come to the listeners of the other driver's IOC with the same instance too.
template <typename Data> bool is_ours(const hxal_t*, const Data&) { return true; }
bool is_ours(const hxal_t* ioc, const hxa_ioc_aen_data_t& data)
{
    return (data.ioc_type == HXA_IOC_TYPE_LL) == (ioc->ioc_type == HXA_IOC_TYPE_LL);
}

template <typename Data> void on_event(void* listener, std::uint32_t event, const Data* data, hxa_timeval_t time) noexcept
{
    try
    {
        const auto& [queue, source, ioc] = *static_cast<Listener*>(listener);
        if (is_ours(ioc, *data))
            queue.put(event_tree(source, event, *data, time));
    }
    catch (...) // out of memory: the event is lost, the library's thread goes on
    {
    }
}

// Listens to all events of cards and ports, until it is destroyed: then no callback runs any more.
class Listening
{
public:
    Listening(Session& session, Queue& queue) : _session(session), _queue(queue) {}
    Listening(const Listening&) = delete;
    Listening& operator=(const Listening&) = delete;
    ~Listening() { hxal_aen_exit(); }

    void added_adapters()
    {
        accept(hxal_adapter_aen_register(nullptr, on_event, add({"host", -1}, nullptr), &_adapter, 0), "new adapters");
    }

    void adapter(const Adapter& adapter)
    {
        const auto name = "adapter " + adapter.name();
        accept(hxal_adapter_aen_register(adapter.handle, on_event, add({name, -1}, nullptr), &_adapter, 0), name);
    }

    void fc(const std::string& name, const hxal_t* ioc)
    {
        const auto source = [&] { return add({name, ioc->instance}, ioc); };
        hxa_port_aen_data_t port{};
        port.pwwn = ioc->pwwn;
        accept(hxal_port_aen_register(ioc, on_event, source(), &port, &_port), name);
        const hxa_audit_aen_data_t audit{ioc->pwwn};
        accept(hxal_audit_aen_register(ioc, on_event, source(), &audit, &_audit), name);
        hxa_lport_aen_data_t logical{};
        accept(hxal_lport_aen_register(ioc, on_event, source(), &logical, &_logical, 0), name); // new ones
        logical.lpwwn = ioc->pwwn;
        accept(hxal_lport_aen_register(ioc, on_event, source(), &logical, &_logical, 0), name);
        hxa_rport_aen_data_t remote{};
        remote.lpwwn = ioc->pwwn;
        accept(hxal_rport_aen_register(ioc, on_event, source(), &remote, &_remote), name);
        hxa_itnim_aen_data_t nexus{};
        nexus.lpwwn = ioc->pwwn;
        accept(hxal_itnim_aen_register(ioc, on_event, source(), &nexus, &_nexus, 0), name);
        accept(hxal_ioc_aen_register(ioc, on_event, source(), &_ioc), name);
    }

    void ethernet(const std::string& name, const hxal_t* ioc)
    {
        const auto source = [&] { return add({name, ioc->instance}, ioc); };
        hxa_port_aen_data_t port{};
        port.mac = ioc->mac;
        accept(hxal_port_aen_register(ioc, on_event, source(), &port, &_port), name);
        accept(hxal_ethport_aen_register(ioc, on_event, source(), nullptr, &_ethernet), name);
        accept(hxal_ioc_aen_register(ioc, on_event, source(), &_ioc), name);
    }

private:
    Listener* add(Event_Source source, const hxal_t* ioc)
    {
        return &_listeners.emplace_back(Listener{_queue, std::move(source), ioc});
    }
    void accept(hxa_status_t status, const std::string& what) { _session.accept(status, "events of " + what); }

    Session& _session;
    Queue& _queue;
    std::deque<Listener> _listeners;

    // The library keeps the registrations; they last as long as the program.
    hxal_adapter_aen_cbhandle_t* _adapter = nullptr;
    hxal_port_aen_cbhandle_t* _port = nullptr;
    hxal_audit_aen_cbhandle_t* _audit = nullptr;
    hxal_lport_aen_cbhandle_t* _logical = nullptr;
    hxal_rport_aen_cbhandle_t* _remote = nullptr;
    hxal_itnim_aen_cbhandle_t* _nexus = nullptr;
    hxal_ioc_aen_cbhandle_t* _ioc = nullptr;
    hxal_ethport_aen_cbhandle_t* _ethernet = nullptr;
};

// Signals that end the following of events, as a descriptor.
int interruptions()
{
    sigset_t signals;
    sigemptyset(&signals);
    for (const int signal : {SIGINT, SIGTERM, SIGHUP})
        sigaddset(&signals, signal);
    pthread_sigmask(SIG_BLOCK, &signals, nullptr);
    return signalfd(-1, &signals, SFD_CLOEXEC);
}

void follow(Session& session, Queue& queue, int interrupted, unsigned count)
{
    pollfd descriptors[] = {{interrupted, POLLIN, 0}, {queue.descriptor(), POLLIN, 0}};
    for (unsigned seen = 0; poll(descriptors, 2, -1) < 0 || descriptors[0].revents == 0;)
        for (const auto& event : queue.take())
        {
            session.answer_line(event, event_text(event));
            if (++seen == count)
                return;
        }
}

} // namespace

void events(Session& session, const Events_Options& options)
{
    const int interrupted = interruptions();
    const Host host(session, hxa_aen_app_test); // nobody else's events are taken
    Queue queue;
    Listening listening(session, queue);
    if (options.port.empty())
    {
        listening.added_adapters();
        for (const auto& adapter : host.adapters())
            listening.adapter(adapter);
    }
    for (const auto& port : host.ports(options.port))
    {
        if (port.fc)
            listening.fc("port " + port.name(), port.fc);
        if (port.ethernet)
            listening.ethernet("port " + port.name(), port.ethernet);
    }
    require(hxal_aen_init(), "events");
    follow(session, queue, interrupted, options.count);
    close(interrupted);
}

} // namespace hxa
