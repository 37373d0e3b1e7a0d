// Provider_Turn: a thread's stay with a provider.
//
// A provider that hangs must not take every thread of the server with it: two are with it at a time, others wait, and give up
// when nobody has come or gone for a while.
#pragma once

#include <chrono>
#include <condition_variable>
#include <mutex>
#include <thread>
#include <vector>

namespace cimserver
{

// Of one provider.
class Provider_Turns
{
public:
    static constexpr std::size_t at_once = 2;

    explicit Provider_Turns(std::chrono::milliseconds patience) : _patience(patience) {}

private:
    friend class Provider_Turn;

    const std::chrono::milliseconds _patience;
    std::mutex _mutex;
    std::condition_variable _left;
    std::vector<std::thread::id> _inside;
    std::chrono::steady_clock::time_point _last_change{};
};

class Provider_Turn
{
public:
    // Waits for a turn. A thread that is with the provider already, and came back through an up-call, needs none. Throws
    // Cim_Error, which names the class, when the provider does not answer others.
    Provider_Turn(Provider_Turns& turns, const char* class_name);
    ~Provider_Turn();
    Provider_Turn(const Provider_Turn&) = delete;
    Provider_Turn& operator=(const Provider_Turn&) = delete;

private:
    Provider_Turns& _turns;
    bool _nested = false;
};

} // namespace cimserver
