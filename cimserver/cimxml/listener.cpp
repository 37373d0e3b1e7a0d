#include "cimserver/cimxml/listener.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <sys/socket.h>
#include <unistd.h>

#include <cerrno>
#include <string>
#include <system_error>

namespace cimserver
{

namespace
{

constexpr int backlog = 512; // connections that wait while others are accepted

[[noreturn]] void fail(int socket, std::uint16_t port)
{
    const int error = errno;
    if (socket >= 0)
        close(socket);
    throw std::system_error(error, std::generic_category(), "cannot listen on 127.0.0.1:" + std::to_string(port));
}

sockaddr* as_address(sockaddr_in& address) { return reinterpret_cast<sockaddr*>(&address); }

} // namespace

Listener listen_on_loopback(std::uint16_t port)
{
    const int socket = ::socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0);
    if (socket < 0)
        fail(socket, port);

    // A restart must not wait for the last connections of the server before it.
    const int on = 1;
    setsockopt(socket, SOL_SOCKET, SO_REUSEADDR, &on, sizeof on);

    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    address.sin_port = htons(port);
    socklen_t size = sizeof address;
    if (bind(socket, as_address(address), size) != 0 || listen(socket, backlog) != 0 ||
        getsockname(socket, as_address(address), &size) != 0)
        fail(socket, port);
    return {socket, ntohs(address.sin_port)};
}

} // namespace cimserver
