#include "sim/model/event_log.h"

#include <algorithm>
#include <ctime>

namespace hxasim
{

namespace
{

hxa_timeval_t time_of_day()
{
    timespec now{};
    clock_gettime(CLOCK_REALTIME, &now);
    return {.tv_sec = static_cast<std::uint32_t>(now.tv_sec), .tv_usec = static_cast<std::uint32_t>(now.tv_nsec / 1000)};
}

} // namespace

void Event_Log::drop_oldest()
{
    _events.pop_front();
    ++_first;
    for (auto& reader : _readers)
        if (reader.next < _first)
        {
            reader.next = _first;
            ++reader.lost;
        }
}

void Event_Log::add(hxa_aen_entry_t event)
{
    if (_events.size() == capacity)
        drop_oldest();
    event.aen_tv = time_of_day();
    event.seq_num = static_cast<std::int32_t>(_first + _events.size() + 1);
    _events.push_back(event);
}

std::size_t Event_Log::take(std::uint32_t application, std::span<hxa_aen_entry_t> room)
{
    if (!is_reader(application))
        return 0;
    auto& next = _readers[application - 1].next;
    const auto count = std::min<std::uint64_t>(room.size(), unread(application));
    std::copy_n(_events.begin() + static_cast<std::ptrdiff_t>(next - _first), count, room.begin());
    next += count;
    auto slowest = std::min_element(_readers.begin(), _readers.end(), [](auto& a, auto& b) { return a.next < b.next; })->next;
    for (; _first < slowest; ++_first)
        _events.pop_front();
    return count;
}

std::uint64_t Event_Log::unread(std::uint32_t application) const
{
    return is_reader(application) ? _first + _events.size() - _readers[application - 1].next : 0;
}

std::uint64_t Event_Log::lost(std::uint32_t application) const
{
    return is_reader(application) ? _readers[application - 1].lost : 0;
}

} // namespace hxasim
