// Gate: lets callers in until it is shut, and lets whoever shuts it wait for those inside.
#pragma once

#include <condition_variable>
#include <mutex>

namespace zmlr
{

// Callers may enter as often as they like, on any thread.
class Gate
{
public:
    bool enter(); // false once it is shut: the caller is not inside
    void leave();

    void shut(); // nobody enters from now on
    bool is_shut();
    void wait(); // until nobody is inside; the caller must not be

private:
    std::mutex _mutex;
    std::condition_variable _empty;
    unsigned _inside = 0;
    bool _shut = false;
};

// One passage through a gate, for a scope. No gate at all (null) is always open.
class Gate_Pass
{
public:
    explicit Gate_Pass(Gate* gate) : _gate(gate), _inside(!gate || gate->enter()) {}
    ~Gate_Pass()
    {
        if (_gate && _inside)
            _gate->leave();
    }
    Gate_Pass(const Gate_Pass&) = delete;
    Gate_Pass& operator=(const Gate_Pass&) = delete;

    explicit operator bool() const { return _inside; }

private:
    Gate* _gate;
    bool _inside;
};

} // namespace zmlr
