#include "raw_client.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

#include <algorithm>
#include <cstdlib>

namespace test
{

namespace
{

// Bytes of the whole answer once its head is there, 0 before.
std::size_t size_of_answer(const std::string& bytes)
{
    const std::size_t head = bytes.find("\r\n\r\n");
    if (head == std::string::npos)
        return 0;
    const std::size_t length = bytes.find("Content-Length: ");
    return head + 4 + (length < head ? std::strtoul(bytes.c_str() + length + 16, nullptr, 10) : 0);
}

} // namespace

Raw_Client::Raw_Client(std::uint16_t port) : _socket(socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0))
{
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    address.sin_port = htons(port);
    if (connect(_socket, reinterpret_cast<sockaddr*>(&address), sizeof address) == 0)
        return;
    close(_socket);
    _socket = -1;
}

Raw_Client::~Raw_Client()
{
    if (_socket >= 0)
        close(_socket);
}

bool Raw_Client::send(const std::string& bytes)
{
    for (std::size_t sent = 0; sent < bytes.size();)
    {
        const ssize_t result = ::send(_socket, bytes.data() + sent, bytes.size() - sent, MSG_NOSIGNAL);
        if (result <= 0)
            return false;
        sent += static_cast<std::size_t>(result);
    }
    return true;
}

void Raw_Client::end_sending() { shutdown(_socket, SHUT_WR); }

std::string Raw_Client::receive(std::chrono::milliseconds time)
{
    const auto deadline = std::chrono::steady_clock::now() + time;
    std::string bytes;
    std::string buffer(std::size_t{1} << 20, '\0');
    while (bytes.empty() || size_of_answer(bytes) == 0 || bytes.size() < size_of_answer(bytes))
    {
        const ssize_t result = readable_until(deadline) ? recv(_socket, buffer.data(), buffer.size(), 0) : 0;
        if (result <= 0)
            break;
        bytes.append(buffer, 0, static_cast<std::size_t>(result));
    }
    return bytes;
}

bool Raw_Client::closed_within(std::chrono::milliseconds time)
{
    char byte = 0;
    return readable_until(std::chrono::steady_clock::now() + time) && recv(_socket, &byte, 1, 0) <= 0;
}

bool Raw_Client::readable_until(std::chrono::steady_clock::time_point deadline) const
{
    const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(deadline - std::chrono::steady_clock::now());
    pollfd entry{_socket, POLLIN, 0};
    return poll(&entry, 1, static_cast<int>(std::max<std::int64_t>(left.count(), 0))) > 0;
}

std::string post(const std::string& body, const std::string& headers)
{
    return "POST /cimom HTTP/1.1\r\nHost: 127.0.0.1\r\n" + headers + "Content-Length: " + std::to_string(body.size()) +
           "\r\n\r\n" + body;
}

} // namespace test
