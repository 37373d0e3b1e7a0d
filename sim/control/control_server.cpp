#include "sim/control/control_server.h"

#include <poll.h>
#include <sys/eventfd.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <cstring>
#include <stdexcept>
#include <utility>

namespace hxasim
{

namespace
{

constexpr std::size_t max_line = 64 * 1024;
constexpr std::size_t max_clients = 16;
constexpr int accept_pause = 100; // ms
constexpr const char* too_long = R"({"error":"line longer than 65536 bytes","ok":false})";

[[noreturn]] void fail(int error, const std::string& what) { throw std::runtime_error(what + ": " + std::strerror(error)); }

// A descriptor on the way to its place.
class New_Descriptor
{
public:
    explicit New_Descriptor(int descriptor, const char* what) : _descriptor(descriptor)
    {
        if (descriptor < 0)
            fail(errno, what);
    }
    New_Descriptor(const New_Descriptor&) = delete;
    New_Descriptor& operator=(const New_Descriptor&) = delete;
    ~New_Descriptor()
    {
        if (_descriptor >= 0)
            close(_descriptor);
    }
    int operator*() const { return _descriptor; }
    int release() { return std::exchange(_descriptor, -1); }

private:
    int _descriptor;
};

sockaddr_un address_of(const std::string& path)
{
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    if (path.size() >= sizeof(address.sun_path))
        fail(ENAMETOOLONG, "socket");
    std::copy(path.begin(), path.end(), address.sun_path);
    return address;
}

template <typename Call> int with_address(Call call, int descriptor, const std::string& path)
{
    const auto address = address_of(path);
    return call(descriptor, reinterpret_cast<const sockaddr*>(&address), sizeof(address)) == 0 ? 0 : errno;
}

int new_socket() { return socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0); }

// A socket file of a process that has ended.
bool is_left_over(const std::string& path)
{
    struct stat status = {};
    if (lstat(path.c_str(), &status) != 0 || !S_ISSOCK(status.st_mode))
        return false;
    New_Descriptor probe(new_socket(), "socket");
    return with_address(connect, *probe, path) == ECONNREFUSED;
}

// The mode that the socket has when it is bound becomes that of its file: nobody else can connect at any moment.
int listen_at(const std::string& path)
{
    New_Descriptor listener(new_socket(), "socket");
    if (fchmod(*listener, 0600) != 0)
        fail(errno, "fchmod");
    int error = with_address(bind, *listener, path);
    if (error == EADDRINUSE && is_left_over(path) && unlink(path.c_str()) == 0)
        error = with_address(bind, *listener, path);
    if (error != 0)
        fail(error, "bind");
    if (listen(*listener, static_cast<int>(max_clients)) != 0)
        fail(errno, "listen");
    return listener.release();
}

} // namespace

void Control_Server::serve(const std::string& path)
{
    std::lock_guard serving(_serving);
    end();
    if (path.empty())
        return;
    std::lock_guard lock(_mutex);
    New_Descriptor wake(eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK), "eventfd");
    _listener = listen_at(path);
    _wake = wake.release();
    _path = path;
    start();
}

// Threads inherit the signal mask of who starts them.
void Control_Server::start()
{
    sigset_t all;
    sigset_t before;
    sigfillset(&all);
    _stopping = false;
    pthread_sigmask(SIG_SETMASK, &all, &before);
    const int error = pthread_create(&_thread, nullptr, run, this);
    pthread_sigmask(SIG_SETMASK, &before, nullptr);
    if (error != 0)
    {
        close_all();
        fail(error, "thread");
    }
    static Control_Server* served = nullptr;
    if (!std::exchange(served, this))
        std::atexit([] { served->remove_socket(); });
}

void Control_Server::end()
{
    {
        std::lock_guard lock(_mutex);
        if (_path.empty())
            return;
        _stopping = true;
        const std::uint64_t one = 1;
        [[maybe_unused]] auto woken = ::write(_wake, &one, sizeof(one));
    }
    pthread_join(_thread, nullptr);
    std::lock_guard lock(_mutex);
    unlink(_path.c_str());
    close_all();
}

void Control_Server::remove_socket()
{
    std::lock_guard lock(_mutex);
    if (!_path.empty())
        unlink(_path.c_str());
}

void Control_Server::close_all()
{
    for (auto& client : _clients)
        close(client.descriptor);
    _clients.clear();
    close(_listener);
    close(_wake);
    _path.clear();
}

void Control_Server::after_fork_in_child()
{
    if (!_path.empty())
        close_all();
    _mutex.unlock();
}

void* Control_Server::run(void* server) noexcept
{
    static_cast<Control_Server*>(server)->work();
    return nullptr;
}

void Control_Server::work()
{
    std::unique_lock lock(_mutex);
    while (!_stopping)
    {
        auto descriptors = waiting();
        const int time = _may_accept ? -1 : accept_pause;
        lock.unlock();
        poll(descriptors.data(), descriptors.size(), time);
        lock.lock();
        _may_accept = true;
        if (!_stopping)
            attend(descriptors);
    }
}

// What the thread waits for: the end, new clients, then each client in the order of the list. A client whose answer is still
// on its way is not listened to.
std::vector<pollfd> Control_Server::waiting() const
{
    std::vector<pollfd> descriptors{{.fd = _wake, .events = POLLIN, .revents = 0},
                                    {.fd = _may_accept ? _listener : -1, .events = POLLIN, .revents = 0}};
    for (const auto& client : _clients)
        descriptors.push_back(
            {.fd = client.descriptor, .events = client.output.empty() ? short{POLLIN} : short{POLLOUT}, .revents = 0});
    return descriptors;
}

void Control_Server::attend(const std::vector<pollfd>& descriptors)
{
    auto client = _clients.begin();
    for (std::size_t i = 2; i < descriptors.size(); ++i)
    {
        auto current = client++;
        if (descriptors[i].revents == 0)
            continue;
        if (attend(*current))
            _clients.splice(_clients.end(), _clients, current);
        else
            hang_up(current);
    }
    if (descriptors[1].revents != 0)
        accept_client();
}

void Control_Server::hang_up(Clients::iterator client)
{
    close(client->descriptor);
    _clients.erase(client);
}

void Control_Server::accept_client()
{
    const int descriptor = accept4(_listener, nullptr, nullptr, SOCK_CLOEXEC | SOCK_NONBLOCK);
    _may_accept = descriptor >= 0 || errno == EAGAIN;
    if (descriptor < 0)
        return;
    if (_clients.size() == max_clients)
        hang_up(_clients.begin());
    _clients.push_back({.descriptor = descriptor});
}

// False when the client is to be hung up on.
bool Control_Server::attend(Client& client)
{
    try
    {
        const bool answering = !client.output.empty();
        if (!(answering ? send(client) : receive(client)))
            return false;
        return !client.output.empty() || converse(client);
    }
    catch (const std::exception&) // no memory
    {
        return false;
    }
}

bool Control_Server::receive(Client& client)
{
    std::array<char, 4096> bytes;
    const auto count = recv(client.descriptor, bytes.data(), bytes.size(), 0);
    if (count <= 0)
        return count < 0 && errno == EAGAIN;
    client.input.append(bytes.data(), static_cast<std::size_t>(count));
    return true;
}

// Answers the lines that are there, each when the answer before has gone out.
bool Control_Server::converse(Client& client)
{
    while (client.output.empty() && !client.last_answer)
    {
        const auto end = std::min(client.input.find('\n'), client.input.size());
        if (end <= max_line && end == client.input.size())
            return true;
        client.last_answer = end > max_line;
        client.output = client.last_answer ? too_long : _handler(std::string_view(client.input).substr(0, end));
        client.output += '\n';
        client.input.erase(0, end + 1);
        if (!send(client))
            return false;
    }
    return !client.output.empty();
}

// As much as goes at once.
bool Control_Server::send(Client& client)
{
    const auto sent = ::send(client.descriptor, client.output.data(), client.output.size(), MSG_NOSIGNAL);
    if (sent < 0)
        return errno == EAGAIN;
    client.output.erase(0, static_cast<std::size_t>(sent));
    return true;
}

} // namespace hxasim
