// The socket that the server accepts connections on.
#pragma once

#include <cstdint>

namespace cimserver
{

// A listening IPv4 socket; whoever takes `socket` closes it.
struct Listener
{
    int socket = -1;
    std::uint16_t port = 0;
};

// Listens on 127.0.0.1 only; port 0 picks a free one. Throws std::system_error when the port cannot be had.
Listener listen_on_loopback(std::uint16_t port);

} // namespace cimserver
