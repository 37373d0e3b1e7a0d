// The registrations of one kind of event: a list, its lock, and the dispatch of an event to those that match.
//
// Lists need no start-up code and nothing of them is taken down at the end of the process, when the event thread may still
// walk them.
#pragma once

#include "hxal/internal/adapter_list.h"
#include "hxal/internal/ioc_list.h"
#include "hxal/internal/memory.h"
#include "hxal/records/aen.h"

#include <memory>
#include <mutex>
#include <vector>

namespace hxal
{

constexpr uint32_t snia_form = 0x1; // the client wants the short form
constexpr uint32_t delivered = 0x4; // the event at hand was handed to this registration

constexpr int16_t no_instance = -1;

// A share of an open descriptor that a handle of the library uses; null when none does.
inline std::shared_ptr<Descriptor> listed_descriptor(int fd)
{
    if (auto found = descriptor_of(fd))
        return found;
    const auto has_it = [=](const hxal_s& ioc) { return ioc.fd == fd; };
    for (hxal_adapter_t* adapter = adapter_list(); adapter; adapter = adapter->next)
        for (hxal_s* head : {adapter->fcioc_list, adapter->ethioc_list})
            if (hxal_s* ioc = first_that(head, has_it))
                return static_cast<Ioc_Node*>(ioc)->node;
    return nullptr;
}

// What a registration is underneath. `Filter` tells which events it is for.
template <typename Record, typename Callback, typename Filter> struct Registration
{
    // Takes descriptor and instance from a handle, which may be missing.
    void bind(const hxal_s* ioc)
    {
        if (!ioc)
            return;
        fd = ioc->fd;
        inst = static_cast<int16_t>(ioc->instance);
        node = listed_descriptor(ioc->fd);
    }

    void* userData = nullptr;
    Callback cbfn = nullptr;
    Filter filter = {};
    uint32_t flags = 0;
    int fd = -1;
    int16_t inst = no_instance;
    std::shared_ptr<Descriptor> node; // keeps `fd` open
    Record* next = nullptr;
};

// `Record` derives from Registration.
template <typename Record> class Registration_List
{
public:
    // The list owns the record from then on; the newest stands first. `handle` is set before the record can be called.
    void add(std::unique_ptr<Record> record, Record*& handle)
    {
        const std::lock_guard lock(_mutex);
        record->next = _head;
        handle = _head = record.release();
    }

    // False when it is not in the list (any more). A record that is being called is freed by its caller.
    bool remove(const Record* record)
    {
        const std::lock_guard lock(_mutex);
        Record** link = &_head;
        while (*link && *link != record)
            link = &(*link)->next;
        Record* const found = *link;
        if (!found)
            return false;
        *link = found->next;
        if (found == _called)
            _called_is_removed = true;
        else
            delete found;
        return true;
    }

    void collect(std::vector<int>& descriptors)
    {
        const std::lock_guard lock(_mutex);
        for (const Record* record = _head; record; record = record->next)
            if (record->fd >= 0)
                descriptors.push_back(record->fd);
    }

    // Calls every record that matches once, without the lock, and starts again from the first one after each call: the list
    // may have changed. The first call that does not return HXA_STATUS_OK ends the dispatch. One thread dispatches at a time.
    template <typename Matches, typename Deliver> hxa_status_t dispatch(Matches matches, Deliver deliver)
    {
        std::unique_lock lock(_mutex);
        hxa_status_t status = HXA_STATUS_OK;
        Record* record;
        while (status == HXA_STATUS_OK && (record = first_that(_head, [&](const Record& each) { return is_due(each, matches); })))
        {
            record->flags |= delivered;
            _called = record;
            lock.unlock();
            status = deliver(*record);
            lock.lock();
            end_call();
        }
        for (record = _head; record; record = record->next)
            record->flags &= ~delivered;
        return status;
    }

private:
    template <typename Matches> static bool is_due(const Record& record, Matches& matches)
    {
        return (record.flags & delivered) == 0 && matches(record);
    }

    void end_call()
    {
        if (_called_is_removed)
            delete _called;
        _called_is_removed = false;
        _called = nullptr;
    }

    std::mutex _mutex;
    Record* _head = nullptr;
    Record* _called = nullptr; // whose callback runs
    bool _called_is_removed = false;
};

} // namespace hxal
