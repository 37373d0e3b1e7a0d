#include "inventory/shell_command.h"

#include "runtime/blocked_signals.h"

#include <fcntl.h>
#include <poll.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <csignal>
#include <optional>

namespace zmlr
{

namespace
{

using Clock = std::chrono::steady_clock;

constexpr rlim_t largest_file = 128 * 1024 * 1024;

// The supervisor's own descriptor, for the command's status.
constexpr int status_descriptor = STDERR_FILENO + 1;

class Descriptor
{
public:
    ~Descriptor() { close(); }
    Descriptor() = default;
    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;

    void close()
    {
        if (number >= 0)
            ::close(number);
        number = -1;
    }

    int number = -1;
};

struct Pipe
{
    Descriptor in; // what is written to `out` is read here
    Descriptor out;

    bool open()
    {
        int ends[2];
        if (pipe2(ends, O_CLOEXEC) != 0)
            return false;
        in.number = ends[0];
        out.number = ends[1];
        return true;
    }
};

// ---- In the child: only what is safe after the fork of a process with threads ----

void take_default_signals()
{
    for (int number = 1; number < NSIG; number++)
        signal(number, SIG_DFL);
    sigset_t none;
    sigemptyset(&none);
    pthread_sigmask(SIG_SETMASK, &none, nullptr);
}

// Leaves the standard descriptors and the one for the status; false when one of them cannot be had.
bool take_descriptors(int status, int output)
{
    constexpr int out_of_the_way = status_descriptor + 1;
    const int from = ::fcntl(status, F_DUPFD, out_of_the_way);
    const int to = output < 0 ? -1 : ::fcntl(output, F_DUPFD, out_of_the_way);
    const int null = ::fcntl(::open("/dev/null", O_RDWR), F_DUPFD, out_of_the_way);
    if (dup2(null, STDIN_FILENO) < 0 || dup2(output < 0 ? null : to, STDOUT_FILENO) < 0 || dup2(null, STDERR_FILENO) < 0 ||
        dup3(from, status_descriptor, O_CLOEXEC) < 0)
        return false;
    closefrom(out_of_the_way);
    return true;
}

void limit_files()
{
    rlimit limit = {};
    getrlimit(RLIMIT_FSIZE, &limit);
    limit.rlim_cur = std::min(limit.rlim_cur, largest_file);
    limit.rlim_max = std::min(limit.rlim_max, largest_file);
    setrlimit(RLIMIT_FSIZE, &limit);
}

// Runs the command as a child of this process, which nobody else waits for, and writes down how it ended.
[[noreturn]] void supervise(const char* command, int status, int output)
{
    setpgid(0, 0);
    if (!take_descriptors(status, output))
        _exit(1);
    take_default_signals();
    limit_files();
    umask(S_IRWXG | S_IRWXO);

    const pid_t shell = fork();
    if (shell == 0)
    {
        execl("/bin/sh", "sh", "-c", command, nullptr);
        _exit(127);
    }
    int ended = 0;
    if (shell > 0 && waitpid(shell, &ended, 0) == shell)
        (void)!write(status_descriptor, &ended, sizeof ended);
    _exit(0);
}

// ---- In the process itself ----

bool wait_for_bytes(const Descriptor& pipe, Clock::time_point deadline)
{
    for (;;)
    {
        const auto left = std::chrono::ceil<std::chrono::milliseconds>(deadline - Clock::now());
        pollfd descriptor = {.fd = pipe.number, .events = POLLIN, .revents = 0};
        const int ready = poll(&descriptor, 1, std::max(0, static_cast<int>(left.count())));
        if (ready >= 0 || errno != EINTR)
            return ready > 0;
    }
}

// Bytes that were read; 0 at the end and when none came in time.
std::size_t read_bytes(const Descriptor& pipe, void* out, std::size_t size, Clock::time_point deadline)
{
    if (!wait_for_bytes(pipe, deadline))
        return 0;
    const ssize_t n = ::read(pipe.number, out, size);
    return n > 0 ? static_cast<std::size_t>(n) : 0;
}

void read_first_line(const Descriptor& pipe, First_Line& line, Clock::time_point deadline)
{
    for (std::size_t size = 0; size + 1 < sizeof line.text; size++)
    {
        if (read_bytes(pipe, &line.text[size], 1, deadline) == 1 && line.text[size] != '\n')
            continue;
        line.text[size] = '\0';
        return;
    }
}

std::optional<int> read_status(const Descriptor& pipe, Clock::time_point deadline)
{
    int ended = 0;
    if (read_bytes(pipe, &ended, sizeof ended, deadline) != sizeof ended)
        return std::nullopt;
    return ended;
}

void wait_for_child(pid_t child)
{
    while (waitpid(child, nullptr, 0) < 0 && errno == EINTR)
    {
    }
}

pid_t start_supervisor(const char* command, const Pipe& status, const Pipe& output)
{
    const Blocked_Signals blocked; // none reaches a handler of this process in its child
    const pid_t child = fork();
    if (child == 0)
        supervise(command, status.out.number, output.out.number);
    // The child does it too: whoever comes first, neither the command nor a kill comes before the group.
    if (child > 0)
        setpgid(child, child);
    return child;
}

} // namespace

int run_shell_command(const char* command, std::chrono::seconds limit, First_Line* first_line)
{
    const Clock::time_point deadline = Clock::now() + limit;
    Pipe status;
    Pipe output;
    if (!status.open() || (first_line && !output.open()))
        return -1;
    const pid_t supervisor = start_supervisor(command, status, output);
    if (supervisor < 0)
        return -1;
    status.out.close();
    output.out.close();

    if (first_line)
        read_first_line(output.in, *first_line, deadline);
    output.in.close();
    const bool in_time = wait_for_bytes(status.in, deadline);
    // While nothing came and the pipe has not ended either, the supervisor lives: its number is its own. Behind the end of the
    // pipe the number may be a stranger's, where a handler of SIGCHLD waits for all children.
    if (!in_time)
        kill(-supervisor, SIGKILL);
    const std::optional<int> ended = in_time ? read_status(status.in, deadline) : std::nullopt;
    wait_for_child(supervisor);
    return ended && WIFEXITED(*ended) ? WEXITSTATUS(*ended) : -1;
}

} // namespace zmlr
