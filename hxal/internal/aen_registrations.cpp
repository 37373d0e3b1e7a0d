#include "hxal/internal/aen_registrations.h"

#include "hxal/internal/list.h"

bool hxal::Registration_List::remove(const void* handle)
{
    const std::lock_guard lock(_mutex);
    Registration** link = &_head;
    while (*link && *link != handle)
        link = &(*link)->next;
    Registration* const found = *link;
    if (!found)
        return false;
    *link = found->next;
    if (found == _called)
        _called_is_removed = true;
    else
        delete found;
    return true;
}

void hxal::Registration_List::collect(std::vector<int>& descriptors)
{
    const std::lock_guard lock(_mutex);
    for (const Registration* each = _head; each; each = each->next)
        if (each->fd >= 0)
            descriptors.push_back(each->fd);
}

void hxal::Registration_List::dispatch(const hxa_aen_entry_t& event, Is_For is_for, Call call)
{
    const auto is_due = [&](const Registration& each) { return (each.flags & delivered) == 0 && is_for(each, event); };
    std::unique_lock lock(_mutex);
    hxa_status_t status = HXA_STATUS_OK;
    Registration* due;
    while (status == HXA_STATUS_OK && (due = first_that(_head, is_due)))
    {
        due->flags |= delivered;
        _called = due;
        lock.unlock();
        status = call(*due, event);
        lock.lock();
        end_call();
    }
    for (Registration* each = _head; each; each = each->next)
        each->flags &= ~delivered;
}

void hxal::Registration_List::end_call()
{
    if (_called_is_removed)
        delete _called;
    _called_is_removed = false;
    _called = nullptr;
}
