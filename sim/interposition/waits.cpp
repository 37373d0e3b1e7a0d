// The waits of libc that this library stands in front of: those that wait for time alone. A select() on descriptors waits for
// them and is left alone.
#include "sim/interposition/waits.h"

#include "sim/hxasim.h"
#include "sim/interposition/next_function.h"

#include <sys/select.h>
#include <sys/syscall.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <ctime>
#include <stdexcept>
#include <string>

namespace
{

using std::chrono::microseconds;
using std::chrono::nanoseconds;
using std::chrono::seconds;

constexpr const char* scale_variable = "HXASIM_TIME_SCALE";
constexpr double unknown_scale = -1;

constinit hxasim::Next_Function<int(const timespec*, timespec*)> next_nanosleep{"nanosleep"};
constinit hxasim::Next_Function<int(int, fd_set*, fd_set*, fd_set*, timeval*)> next_select{"select"};

constinit std::atomic<double> scale = unknown_scale;
constinit std::atomic<nanoseconds::rep> slept = 0;

bool is_scale(double value) noexcept { return value >= 0 && value <= 1; }

double scale_of_environment() noexcept
{
    const char* text = secure_getenv(scale_variable);
    if (!text || *text == '\0')
        return 1;
    char* end = nullptr;
    const double value = std::strtod(text, &end);
    if (*end == '\0' && is_scale(value))
        return value;
    std::fprintf(stderr, "hxasim: %s=%s: must be a number from 0 to 1\n", scale_variable, text);
    return 1;
}

double current_scale() noexcept
{
    if (const double known = scale.load(std::memory_order_relaxed); known != unknown_scale)
        return known;
    double unknown = unknown_scale;
    scale.compare_exchange_strong(unknown, scale_of_environment());
    return scale.load(std::memory_order_relaxed);
}

nanoseconds scaled(nanoseconds wait, double by) noexcept
{
    return nanoseconds(static_cast<nanoseconds::rep>(static_cast<double>(wait.count()) * by));
}

// What is left of a wait, as the caller counts: what was cut off it is not left.
nanoseconds unscaled(nanoseconds left, double by) noexcept { return by > 0 ? scaled(left, 1 / by) : nanoseconds::zero(); }

timespec as_timespec(nanoseconds time) noexcept
{
    const auto whole = std::chrono::floor<seconds>(time);
    return {.tv_sec = whole.count(), .tv_nsec = (time - whole).count()};
}

timeval as_timeval(nanoseconds time) noexcept
{
    const auto whole = std::chrono::floor<seconds>(time);
    return {.tv_sec = whole.count(), .tv_usec = std::chrono::duration_cast<microseconds>(time - whole).count()};
}

// A wait of more than a year, or of no proper time, is handed on as it is.
bool is_time(std::int64_t whole, std::int64_t fraction, std::int64_t fractions) noexcept
{
    return whole >= 0 && whole < 31'536'000 && fraction >= 0 && fraction < fractions;
}

int real_nanosleep(const timespec* wanted, timespec* left) noexcept
{
    auto* next = next_nanosleep.get();
    return next ? next(wanted, left) : static_cast<int>(syscall(SYS_nanosleep, wanted, left));
}

int real_select(int count, fd_set* readable, fd_set* writable, fd_set* exceptional, timeval* timeout) noexcept
{
    auto* next = next_select.get();
    if (next)
        return next(count, readable, writable, exceptional, timeout);
    return static_cast<int>(syscall(SYS_select, count, readable, writable, exceptional, timeout));
}

int sleep_for(nanoseconds wanted, timespec* remaining) noexcept
{
    const double by = current_scale();
    slept += wanted.count();
    const timespec shortened = as_timespec(scaled(wanted, by));
    timespec left{};
    const int result = real_nanosleep(&shortened, &left);
    if (result != 0 && remaining)
        *remaining = as_timespec(unscaled(seconds(left.tv_sec) + nanoseconds(left.tv_nsec), by));
    return result;
}

} // namespace

std::chrono::nanoseconds hxasim::take_slept() { return nanoseconds(slept.exchange(0)); }

void hxasim::set_time_scale(double value)
{
    if (!is_scale(value))
        throw std::runtime_error("time scale " + std::to_string(value) + ": must be from 0 to 1");
    scale = value;
}

#pragma GCC visibility push(default)
extern "C"
{

    int nanosleep(const timespec* wanted, timespec* remaining)
    {
        if (!wanted || !is_time(wanted->tv_sec, wanted->tv_nsec, 1'000'000'000))
            return real_nanosleep(wanted, remaining);
        return sleep_for(seconds(wanted->tv_sec) + nanoseconds(wanted->tv_nsec), remaining);
    }

    int usleep(useconds_t wanted) { return sleep_for(microseconds(wanted), nullptr); }

    int select(int count, fd_set* readable, fd_set* writable, fd_set* exceptional, timeval* timeout)
    {
        const bool sleeps = !readable && !writable && !exceptional && timeout;
        if (!sleeps || !is_time(timeout->tv_sec, timeout->tv_usec, 1'000'000))
            return real_select(count, readable, writable, exceptional, timeout);
        const auto wanted = seconds(timeout->tv_sec) + microseconds(timeout->tv_usec);
        const double by = current_scale();
        slept += nanoseconds(wanted).count();
        timeval shortened = as_timeval(scaled(wanted, by));
        const int result = real_select(count, nullptr, nullptr, nullptr, &shortened);
        *timeout = as_timeval(unscaled(seconds(shortened.tv_sec) + microseconds(shortened.tv_usec), by));
        return result;
    }

} // extern "C"
#pragma GCC visibility pop
