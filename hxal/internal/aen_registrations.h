// The registrations of one kind of event: a list, its lock, and the dispatch of an event to those that match.
//
// Lists need no start-up code and nothing of them is taken down at the end of the process, when the event thread may still
// walk them.
#pragma once

#include "hxal/internal/descriptor.h"
#include "hxal/records/aen.h"

#include <memory>
#include <mutex>
#include <vector>

namespace hxal
{

constexpr uint32_t snia_form = 0x1; // the client wants the short form
constexpr uint32_t delivered = 0x4; // the event at hand was handed to this registration

constexpr int16_t no_instance = -1;

// Whose events of its kind a registration is for. What a kind does not look at stays 0.
struct Filter
{
    wwn_t wwn = 0;            // of the port or the logical port
    wwn_t rpwwn = 0;          // of the remote port; 0: any
    mac_t mac = {};           // of the port
    char serial_num[13] = {}; // of the card
    bool any_added = false;   // cards that are added, whichever
};

// A callback of any kind and form; whoever calls it knows which.
using Any_Callback = void (*)();

struct Registration
{
    void* userData = nullptr;
    Any_Callback callback = nullptr;
    Filter filter = {};
    uint32_t flags = 0;
    int fd = -1;
    int16_t inst = no_instance;
    std::shared_ptr<Descriptor> node = {}; // keeps `fd` open
    Registration* next = nullptr;
};

class Registration_List
{
public:
    using Is_For = bool (*)(const Registration& registration, const hxa_aen_entry_t& event);
    using Call = hxa_status_t (*)(const Registration& registration, const hxa_aen_entry_t& event);

    // The list owns the registration from then on; the newest stands first. `handle`, a client's name for its address, is set
    // before it can be called.
    template <typename Handle> void add(std::unique_ptr<Registration> registration, Handle*& handle)
    {
        const std::lock_guard lock(_mutex);
        registration->next = _head;
        _head = registration.release();
        handle = reinterpret_cast<Handle*>(_head);
    }

    // False when it is not in the list (any more). A registration that is being called is freed by its caller.
    bool remove(const void* handle);

    // Adds the descriptors that the registrations were made on.
    void collect(std::vector<int>& descriptors);

    // Calls every registration that the event is for once, without the lock, and starts again from the first one after each
    // call: the list may have changed. The first call that does not return HXA_STATUS_OK ends the dispatch. One thread
    // dispatches at a time.
    void dispatch(const hxa_aen_entry_t& event, Is_For is_for, Call call);

private:
    void end_call();

    std::mutex _mutex;
    Registration* _head = nullptr;
    Registration* _called = nullptr; // whose callback runs
    bool _called_is_removed = false;
};

} // namespace hxal
