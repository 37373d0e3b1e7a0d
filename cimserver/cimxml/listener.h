// The socket that the server accepts connections on.
#pragma once

#include <cstdint>
#include <string>

namespace cimserver
{

// Whether a text is a numeric IPv4 or IPv6 address, and whether only this host can reach it (127.0.0.0/8, ::1).
bool is_address(const std::string& text);
bool is_loopback(const std::string& address);

// "127.0.0.1:5988", "[::1]:5988".
std::string endpoint_text(const std::string& address, std::uint16_t port);

// A listening TCP socket.
class Listener
{
public:
    // Port 0 picks a free one. Throws std::system_error when the port cannot be had on the address, a numeric one.
    Listener(const std::string& address, std::uint16_t port);
    ~Listener();
    Listener(const Listener&) = delete;
    Listener& operator=(const Listener&) = delete;

    int socket() const { return _socket; }
    std::uint16_t port() const { return _port; }

    // Refuses new connections. The socket itself stays until the end: its number must not be given away while a thread may
    // still be about to accept from it.
    void refuse();

private:
    int _socket = -1;
    std::uint16_t _port = 0;
};

} // namespace cimserver
