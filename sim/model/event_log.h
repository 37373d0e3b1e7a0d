// The events of one I/O controller, and how far each application has read them.
#pragma once

#include "hxal/records/aen.h"

#include <array>
#include <cstdint>
#include <deque>
#include <span>

namespace hxasim
{

// Applications have identities of their own to fetch events under; 0 has none.
constexpr std::uint32_t max_application = 4;

// Every application reads every event once, in the order of their raising. What all have read is forgotten; of the rest only
// the newest are kept, and an application that has not read a dropped one has lost it.
class Event_Log
{
public:
    static constexpr std::size_t capacity = 65'536;

    // Gives the event its sequence number (1, 2, ...) and the time of day.
    void add(hxa_aen_entry_t event);

    // The next events for the application, oldest first: how many were put into `room`.
    std::size_t take(std::uint32_t application, std::span<hxa_aen_entry_t> room);

    std::uint64_t unread(std::uint32_t application) const;
    std::uint64_t lost(std::uint32_t application) const;

private:
    struct Reader
    {
        std::uint64_t next = 0; // event that it reads next, counted over all that were ever added
        std::uint64_t lost = 0;
    };

    static bool is_reader(std::uint32_t application) { return application >= 1 && application <= max_application; }
    void drop_oldest();

    std::deque<hxa_aen_entry_t> _events;
    std::uint64_t _first = 0; // number of the oldest that is kept
    std::array<Reader, max_application> _readers;
};

} // namespace hxasim
