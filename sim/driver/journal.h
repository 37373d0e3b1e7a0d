// What the simulated drivers remember of the requests they got, bounded in number and in bytes.
#pragma once

#include "sim/hxasim.h"
#include "sim/model/node.h"

#include <deque>
#include <string_view>

namespace hxasim
{

// A request as it is kept: cheaper to store than the Request that a test gets.
struct Journal_Entry
{
    Node node{};
    std::uint32_t code = 0;
    std::string_view name = {}; // of the catalogue
    int instance = -1;
    std::vector<std::uint8_t> sent = {};
    std::vector<std::uint8_t> answered = {};
    int error = 0;
    bool carries_status = false;
    std::chrono::nanoseconds slept{};
};

class Journal
{
public:
    void add(Journal_Entry entry);                 // drops the oldest ones beyond the bounds
    void add_violation(std::string text);          // dropped beyond the bound
    std::vector<Request> take();                   // oldest first; leaves none
    std::uint64_t count() const { return _count; } // of all that were added
    std::size_t kept() const { return _entries.size(); }
    const std::vector<std::string>& violations() const { return _violations; }
    void clear();

private:
    std::deque<Journal_Entry> _entries;
    std::size_t _bytes = 0;
    std::uint64_t _count = 0;
    std::vector<std::string> _violations;
};

} // namespace hxasim
