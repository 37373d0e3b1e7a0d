// The lights by which a person finds a port and the other end of its link.
#pragma once

#include <chrono>
#include <cstdint>
#include <optional>

namespace hxasim
{

class Beacon
{
public:
    // Until they are set again, or for some seconds when it is not 0.
    void set(bool port, bool link, std::uint32_t seconds)
    {
        _port = port;
        _link = link;
        _end.reset();
        if (seconds != 0)
            _end = Clock::now() + std::chrono::seconds(seconds);
    }

    bool port_is_on() const { return _port && !is_over(); }
    bool link_is_on() const { return _link && !is_over(); }

private:
    using Clock = std::chrono::steady_clock;

    bool is_over() const { return _end && Clock::now() >= *_end; }

    bool _port = false;
    bool _link = false;
    std::optional<Clock::time_point> _end;
};

} // namespace hxasim
