// Refusal_Log: tells on standard error which logins were refused.
//
// Whoever guesses passwords must not fill the log: at most a few lines a minute are written, what comes on top is counted, and
// the number is told with the next line. A name is what a stranger sent: it is cut, and whatever is no printable ASCII
// character in it stands as "\xHH".
#pragma once

#include <chrono>
#include <mutex>
#include <string>

namespace cimserver
{

class Refusal_Log
{
public:
    static constexpr unsigned lines_a_minute = 10;

    // Safe to call from several threads at once.
    void tell(const std::string& name, const std::string& address);

private:
    using Clock = std::chrono::steady_clock;

    std::mutex _mutex;
    Clock::time_point _minute; // when the current one began
    unsigned _lines = 0;       // in it
    unsigned long _untold = 0;
};

} // namespace cimserver
