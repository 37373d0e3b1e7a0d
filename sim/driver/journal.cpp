#include "sim/driver/journal.h"

#include <cstdlib>

namespace hxasim
{

namespace
{

constexpr std::size_t max_bytes = 128 * 1024 * 1024;
constexpr std::size_t max_violations = 1000;

// Nobody takes the requests of a process that only preloads the simulator: it can be told to keep fewer.
std::size_t max_entries()
{
    static const std::size_t number = []
    {
        const char* text = secure_getenv("HXASIM_JOURNAL");
        return text ? std::strtoul(text, nullptr, 10) : 100'000UL;
    }();
    return number;
}

std::size_t size_of(const Journal_Entry& entry) { return entry.sent.size() + entry.answered.size(); }

Request as_request(Journal_Entry& entry)
{
    return {.node = path_of(entry.node),
            .command = entry.code,
            .name = std::string(entry.name),
            .instance = entry.instance,
            .sent = std::move(entry.sent),
            .answered = std::move(entry.answered),
            .error = entry.error,
            .carries_status = entry.carries_status,
            .slept = entry.slept};
}

} // namespace

void Journal::add(Journal_Entry entry)
{
    ++_count;
    _bytes += size_of(entry);
    _entries.push_back(std::move(entry));
    while (_entries.size() > max_entries() || _bytes > max_bytes)
    {
        _bytes -= size_of(_entries.front());
        _entries.pop_front();
    }
}

void Journal::add_violation(std::string text)
{
    if (_violations.size() < max_violations)
        _violations.push_back(std::move(text));
}

std::vector<Request> Journal::take()
{
    std::vector<Request> requests;
    requests.reserve(_entries.size());
    for (auto& entry : _entries)
        requests.push_back(as_request(entry));
    _entries.clear();
    _bytes = 0;
    return requests;
}

void Journal::clear() { *this = Journal(); }

} // namespace hxasim
