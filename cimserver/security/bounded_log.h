// Bounded_Log: tells on standard error what strangers can cause as often as they like.
//
// Whoever guesses passwords must not fill the log: at most a few lines a minute are written, what comes on top is counted, and
// the number is told with the next line.
#pragma once

#include <chrono>
#include <mutex>
#include <string>

namespace cimserver
{

class Bounded_Log
{
public:
    static constexpr unsigned lines_a_minute = 10;

    explicit Bounded_Log(std::string others) : _others(std::move(others)) {} // "more logins were refused"

    // Nothing in a line can begin another one. Safe to call from several threads at once.
    void tell(const std::string& line);

private:
    using Clock = std::chrono::steady_clock;

    const std::string _others;
    std::mutex _mutex;
    Clock::time_point _minute; // when the current one began
    unsigned _lines = 0;       // in it
    unsigned long _untold = 0;
};

// A name that a stranger sent, for such a line: it is cut, and whatever is no printable ASCII character in it stands as "\xHH".
std::string printable_name(const std::string& name);

} // namespace cimserver
