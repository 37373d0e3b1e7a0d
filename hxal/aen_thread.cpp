#include "hxal/aen.h"

#include "hxal/internal/aen_dispatch.h"
#include "hxal/internal/application.h"
#include "hxal/library.h"

#include <algorithm>
#include <atomic>
#include <cerrno>
#include <csignal>
#include <cstdio>
#include <memory>
#include <mutex>
#include <new>
#include <optional>
#include <poll.h>
#include <pthread.h>
#include <sys/eventfd.h>
#include <unistd.h>

namespace
{

constexpr int wait_milliseconds = 5000;

// How long a round rests after the drivers promised events and had none, so that a driver that lies does not take a
// processor for itself.
constexpr int rest_milliseconds = 1000;

enum class State
{
    running,
    stopped_by_callback, // a callback may still take that back
    stopped,
};

struct Thread
{
    pthread_t id;
    pid_t process; // a child of fork() inherits the variables but not the thread
};

// The thread, if there is one. The mutex is for those who start and end it, never for the thread itself.
constinit std::mutex life;
constinit std::optional<Thread> thread;
constinit std::atomic<State> state{State::stopped};
constinit int wake_up = -1; // eventfd

thread_local bool is_event_thread = false;

bool is_running() { return state == State::running; }

using Entries = std::unique_ptr<hxa_aen_entry_t[]>;

// As select() has it: what is hung up or broken is readable too, and the request tells why.
constexpr short readable = POLLIN | POLLHUP | POLLERR;

// What poll() waits for. Sorted, each descriptor once; the first one wakes the thread up.
std::vector<pollfd> descriptors_to_watch()
{
    std::vector<int> numbers = hxal::hxal_aen_fd_collect();
    std::sort(numbers.begin(), numbers.end());
    numbers.erase(std::unique(numbers.begin(), numbers.end()), numbers.end());
    std::vector<pollfd> watched{{.fd = wake_up, .events = POLLIN, .revents = 0}};
    for (const int number : numbers)
        watched.push_back({.fd = number, .events = POLLIN, .revents = 0});
    return watched;
}

// Until somebody ends the thread, or the time is over.
void rest(int milliseconds)
{
    pollfd ended{.fd = wake_up, .events = POLLIN, .revents = 0};
    ::poll(&ended, 1, milliseconds);
}

bool is_readable(const std::vector<pollfd>& watched, int fd)
{
    return std::any_of(watched.begin() + 1, watched.end(),
                       [=](const pollfd& each) { return each.fd == fd && (each.revents & readable) != 0; });
}

// Fetches and hands out what one IOC has; a batch that was fetched is handed out to its end. Whether there was anything.
bool drain(const hxal_t& ioc, hxa_aen_entry_t* entries, hxa_aen_app_t app)
{
    bool any = false;
    int count = HXA_AEN_MAX_ENTRIES;
    while (is_running() && count >= HXA_AEN_MAX_ENTRIES)
    {
        count = HXA_AEN_MAX_ENTRIES;
        if (hxal_aen_get_events(&ioc, entries, &count, app) != HXA_STATUS_OK)
            return any;
        const int held = std::clamp(count, 0, HXA_AEN_MAX_ENTRIES);
        for (int entry = 0; entry < held; ++entry)
            hxal::dispatch_event(entries[entry]);
        any = any || held > 0;
    }
    return any;
}

bool drain_readable(const std::vector<pollfd>& watched, hxa_aen_entry_t* entries, hxa_aen_app_t app)
{
    bool any = false;
    for (const hxal_t* ioc = hxal_ioc_get_list(); ioc; ioc = ioc->next)
        if (ioc->fd >= 0 && is_readable(watched, ioc->fd) && drain(*ioc, entries, app))
            any = true;
    return any;
}

void watch_once(hxa_aen_entry_t* entries, hxa_aen_app_t app)
{
    std::vector<pollfd> watched = descriptors_to_watch();
    const int ready = ::poll(watched.data(), watched.size(), wait_milliseconds);
    const bool is_broken =
        std::any_of(watched.begin(), watched.end(), [](const pollfd& each) { return (each.revents & POLLNVAL) != 0; });
    if (ready < 0 || is_broken)
    {
        std::printf("%s:%d: select failed\n", __func__, __LINE__);
        return rest(wait_milliseconds);
    }
    if (ready > 0 && !drain_readable(watched, entries, app))
        rest(rest_milliseconds);
}

void* run(void*) noexcept
{
    is_event_thread = true;
    const hxa_aen_app_t app = hxal::current_application();
    const Entries entries(new (std::nothrow) hxa_aen_entry_t[HXA_AEN_MAX_ENTRIES]);
    if (!entries)
    {
        std::printf("%s:%d: malloc failed\n", __func__, __LINE__);
        state = State::stopped;
    }
    while (is_running())
        try
        {
            watch_once(entries.get(), app);
        }
        catch (const std::bad_alloc&)
        {
            rest(wait_milliseconds);
        }
    return nullptr;
}

// Signals are the program's: the thread starts with all of them blocked but those that a fault of its own raises.
int start_thread(pthread_t& started)
{
    sigset_t blocked;
    sigset_t before;
    sigfillset(&blocked);
    for (const int fault : {SIGSEGV, SIGBUS, SIGFPE, SIGILL})
        sigdelset(&blocked, fault);
    pthread_sigmask(SIG_SETMASK, &blocked, &before);
    const int error = ::pthread_create(&started, nullptr, run, nullptr);
    pthread_sigmask(SIG_SETMASK, &before, nullptr);
    return error;
}

void forget_thread()
{
    thread.reset();
    ::close(wake_up);
    wake_up = -1;
}

// Ends the thread, if there is one, and waits until it is gone. From the first line on no callback can take an end back.
void end_thread()
{
    state = State::stopped;
    if (!thread)
        return;
    if (thread->process == ::getpid())
    {
        ::eventfd_write(wake_up, 1);
        ::pthread_join(thread->id, nullptr);
    }
    forget_thread();
}

bool is_alive() { return thread && thread->process == ::getpid() && is_running(); }

// Ends the thread before what it walks is taken down: at the end of the process, or when the library is unloaded.
struct Ending
{
    ~Ending() { hxal_aen_exit(); }
};

hxa_status_t resume_from_callback()
{
    State stopped = State::stopped_by_callback;
    return state.compare_exchange_strong(stopped, State::running) || stopped == State::running ? HXA_STATUS_OK
                                                                                               : HXA_STATUS_FAILED;
}

void stop_from_callback()
{
    State running = State::running;
    state.compare_exchange_strong(running, State::stopped_by_callback);
}

} // namespace

hxa_status_t hxal_aen_init(void)
{
    if (is_event_thread)
        return resume_from_callback();
    if (hxal::current_application() == hxa_aen_app_tessik)
        return HXA_STATUS_OK;
    static const Ending ending; // younger, so gone earlier, than everything that exists before the program runs
    const std::lock_guard lock(life);
    if (is_alive())
        return HXA_STATUS_OK;
    end_thread();
    wake_up = ::eventfd(0, EFD_CLOEXEC);
    if (wake_up < 0)
        return hxal_get_status(errno);
    state = State::running;
    Thread started{.id = {}, .process = ::getpid()};
    if (const int error = start_thread(started.id); error != 0)
    {
        state = State::stopped;
        forget_thread();
        return hxal_get_status(error);
    }
    thread = started;
    return HXA_STATUS_OK;
}

void hxal_aen_exit(void)
{
    if (is_event_thread)
        return stop_from_callback();
    const std::lock_guard lock(life);
    end_thread();
}
