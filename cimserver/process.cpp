#include "cimserver/process.h"

#include <fcntl.h>
#include <semaphore.h>
#include <sys/resource.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <algorithm>
#include <atomic>
#include <cerrno>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <stdexcept>

namespace cimserver
{
namespace
{

constexpr std::size_t other_files = 256; // the module's, the listeners', connections that are being cut

sem_t wished;
std::atomic<bool> stop_wished = false;
static_assert(std::atomic<bool>::is_always_lock_free);

void wish_stop(int)
{
    stop_wished = true;
    sem_post(&wished);
}

void wish_reload(int) { sem_post(&wished); }

} // namespace

void open_standard_descriptors()
{
    for (const int descriptor : {STDIN_FILENO, STDOUT_FILENO, STDERR_FILENO})
        if (fcntl(descriptor, F_GETFD) < 0)
            (void)open("/dev/null", O_RDWR); // takes the lowest number that is free: this one
}

void reserve_descriptors(std::size_t connections)
{
    const rlim_t needed = connections + other_files;
    rlimit limit{};
    if (getrlimit(RLIMIT_NOFILE, &limit) != 0 || limit.rlim_cur >= needed)
        return;
    limit.rlim_cur = std::min(needed, limit.rlim_max);
    if (setrlimit(RLIMIT_NOFILE, &limit) != 0 || limit.rlim_cur < needed)
        throw std::runtime_error(std::to_string(connections) + " connections need " + std::to_string(needed) +
                                 " open files, and this process may have " + std::to_string(limit.rlim_max) +
                                 ": lower --max-connections, or raise the limit (ulimit -n, LimitNOFILE= of a systemd unit)");
}

// Handlers, even where nothing is to be done: what is ignored stays so in every program that the module starts.
void handle_signals()
{
    sem_init(&wished, 0, 0);
    for (const int number : {SIGPIPE, SIGQUIT, SIGALRM, SIGVTALRM, SIGPROF, SIGUSR1, SIGUSR2, SIGPOLL, SIGPWR, SIGXCPU, SIGXFSZ})
        std::signal(number, [](int) {});
    std::signal(SIGTERM, wish_stop);
    std::signal(SIGINT, wish_stop);
    std::signal(SIGHUP, wish_reload);
}

Wish next_wish()
{
    while (sem_wait(&wished) != 0)
    {
    }
    return stop_wished ? Wish::stop : Wish::reload;
}

std::string take_service_manager()
{
    const char* address = std::getenv("NOTIFY_SOCKET");
    std::string taken = address ? address : "";
    unsetenv("NOTIFY_SOCKET");
    return taken;
}

void tell_ready(const std::string& service_manager)
{
    if (service_manager.empty())
        return;
    sockaddr_un address{AF_UNIX, {}};
    const std::size_t size = service_manager.copy(address.sun_path, sizeof address.sun_path);
    if (address.sun_path[0] == '@')
        address.sun_path[0] = '\0'; // a name of the kernel's own, no file
    const auto length = static_cast<socklen_t>(offsetof(sockaddr_un, sun_path) + size);
    const int descriptor = socket(AF_UNIX, SOCK_DGRAM | SOCK_CLOEXEC, 0);
    if (sendto(descriptor, "READY=1", 7, MSG_NOSIGNAL, reinterpret_cast<const sockaddr*>(&address), length) < 0)
        std::fprintf(stderr, "zmlr-cimserver: cannot tell %s that it is ready: %s\n", service_manager.c_str(),
                     std::strerror(errno));
    close(descriptor);
}

} // namespace cimserver
