#include "cimserver/process.h"

#include <fcntl.h>
#include <semaphore.h>
#include <sys/resource.h>
#include <unistd.h>

#include <algorithm>
#include <atomic>
#include <csignal>
#include <stdexcept>
#include <string>

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

} // namespace cimserver
