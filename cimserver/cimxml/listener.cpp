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

sockaddr* as_address(sockaddr_in& address) { return reinterpret_cast<sockaddr*>(&address); }

} // namespace

Listener::Listener(std::uint16_t port) : _socket(::socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0))
{
    const int on = 1; // a restart must not wait for the last connections of the server before it
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    address.sin_port = htons(port);
    socklen_t size = sizeof address;
    if (_socket < 0 || setsockopt(_socket, SOL_SOCKET, SO_REUSEADDR, &on, sizeof on) != 0 ||
        bind(_socket, as_address(address), size) != 0 || listen(_socket, backlog) != 0 ||
        getsockname(_socket, as_address(address), &size) != 0)
    {
        const int error = errno;
        close(_socket);
        throw std::system_error(error, std::generic_category(), "cannot listen on 127.0.0.1:" + std::to_string(port));
    }
    _port = ntohs(address.sin_port);
}

Listener::~Listener() { close(_socket); }

void Listener::refuse() { shutdown(_socket, SHUT_RDWR); }

} // namespace cimserver
