#include "cimserver/cimxml/listener.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <sys/socket.h>
#include <unistd.h>

#include <cerrno>
#include <optional>
#include <system_error>

namespace cimserver
{
namespace
{

constexpr int backlog = 512; // connections that wait while others are accepted

// An address of either family with its size.
struct Socket_Address
{
    union
    {
        sockaddr any;
        sockaddr_in v4;
        sockaddr_in6 v6;
    };
    socklen_t size;
};

std::optional<Socket_Address> read_address(const std::string& text, std::uint16_t port)
{
    Socket_Address address{};
    if (inet_pton(AF_INET, text.c_str(), &address.v4.sin_addr) == 1)
    {
        address.v4.sin_family = AF_INET;
        address.v4.sin_port = htons(port);
        address.size = sizeof address.v4;
        return address;
    }
    address.v6 = {};
    if (inet_pton(AF_INET6, text.c_str(), &address.v6.sin6_addr) != 1)
        return std::nullopt;
    address.v6.sin6_family = AF_INET6;
    address.v6.sin6_port = htons(port);
    address.size = sizeof address.v6;
    return address;
}

std::uint16_t port_of(const Socket_Address& address)
{
    return ntohs(address.any.sa_family == AF_INET ? address.v4.sin_port : address.v6.sin6_port);
}

} // namespace

bool is_address(const std::string& text) { return read_address(text, 0).has_value(); }

bool is_loopback(const std::string& text)
{
    const auto address = read_address(text, 0);
    if (!address)
        return false;
    if (address->any.sa_family == AF_INET)
        return ntohl(address->v4.sin_addr.s_addr) >> 24 == IN_LOOPBACKNET;
    return IN6_IS_ADDR_LOOPBACK(&address->v6.sin6_addr);
}

std::string endpoint_text(const std::string& address, std::uint16_t port)
{
    const bool v6 = address.find(':') != std::string::npos;
    return (v6 ? "[" + address + "]" : address) + ":" + std::to_string(port);
}

Listener::Listener(const std::string& text, std::uint16_t port)
{
    const int on = 1; // a restart must not wait for the last connections of the server before it
    auto address = read_address(text, port);
    if (!address)
        throw std::system_error(std::make_error_code(std::errc::invalid_argument), "no address: " + text);
    _socket = ::socket(address->any.sa_family, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0);
    if (_socket < 0 || setsockopt(_socket, SOL_SOCKET, SO_REUSEADDR, &on, sizeof on) != 0 ||
        bind(_socket, &address->any, address->size) != 0 || listen(_socket, backlog) != 0 ||
        getsockname(_socket, &address->any, &address->size) != 0)
    {
        const int error = errno;
        close(_socket);
        throw std::system_error(error, std::generic_category(), "cannot listen on " + endpoint_text(text, port));
    }
    _port = port_of(*address);
}

Listener::~Listener() { close(_socket); }

void Listener::refuse() { shutdown(_socket, SHUT_RDWR); }

} // namespace cimserver
