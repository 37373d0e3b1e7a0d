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
    ~Listener() { close(); }
    Listener(const Listener&) = delete;
    Listener& operator=(const Listener&) = delete;

    int socket() const { return _socket; } // -1 when closed
    std::uint16_t port() const { return _port; }
    void close();

private:
    int _socket;
    std::uint16_t _port = 0;
};

} // namespace cimserver
