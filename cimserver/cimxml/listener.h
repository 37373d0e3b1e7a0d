// The socket that the server accepts connections on.
#pragma once

#include <cstdint>

namespace cimserver
{

// A listening IPv4 socket on 127.0.0.1.
class Listener
{
public:
    explicit Listener(std::uint16_t port); // 0 picks a free one; throws std::system_error when the port cannot be had
    ~Listener();
    Listener(const Listener&) = delete;
    Listener& operator=(const Listener&) = delete;

    int socket() const { return _socket; }
    std::uint16_t port() const { return _port; }

    // Refuses new connections. The socket itself stays until the end: its number must not be given away while a thread may
    // still be about to accept from it.
    void refuse();

private:
    int _socket;
    std::uint16_t _port = 0;
};

} // namespace cimserver
