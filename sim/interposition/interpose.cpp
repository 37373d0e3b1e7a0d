// The functions of libc that this library stands in front of. Only the two nodes and their descriptors are ours; nothing
// on the way of anybody else's call takes a lock or memory.
#include "sim/interposition/next_function.h"
#include "sim/interposition/process.h"
#include "sim/interposition/waits.h"

#include <fcntl.h>
#include <sys/ioctl.h>
#include <sys/syscall.h>
#include <unistd.h>

#include <atomic>
#include <cerrno>
#include <cstdarg>
#include <new>

namespace
{

using hxasim::Next_Function;
using hxasim::simulator;

constinit Next_Function<int(const char*, int, ...)> next_open{"open"};
constinit Next_Function<int(const char*, int, ...)> next_open64{"open64"};
constinit Next_Function<int(const char*, int)> next_open_2{"__open_2"};
constinit Next_Function<int(const char*, int)> next_open64_2{"__open64_2"};
constinit Next_Function<int(int, const char*, int, ...)> next_openat{"openat"};
constinit Next_Function<int(int, const char*, int, ...)> next_openat64{"openat64"};
constinit Next_Function<int(int, const char*, int)> next_openat_2{"__openat_2"};
constinit Next_Function<int(int, const char*, int)> next_openat64_2{"__openat64_2"};
constinit Next_Function<int(int, unsigned long, ...)> next_ioctl{"ioctl"};
constinit Next_Function<int(int)> next_close{"close"};

// Which descriptors are simulated.
constinit std::array<std::atomic<bool>, 65536> simulated{};

bool is_simulated(int descriptor) noexcept
{
    return descriptor >= 0 && static_cast<std::size_t>(descriptor) < simulated.size() &&
           simulated[static_cast<std::size_t>(descriptor)].load(std::memory_order_acquire);
}

int real_close(int descriptor)
{
    auto* next = next_close.get();
    return next ? next(descriptor) : static_cast<int>(syscall(SYS_close, descriptor));
}

int fail(int error) noexcept
{
    errno = error;
    return -1;
}

// Runs `work`, which answers 0 or more, or a negated errno.
template <typename Work> int guarded(Work work) noexcept
{
    try
    {
        int result = work();
        return result >= 0 ? result : fail(-result);
    }
    catch (const std::bad_alloc&)
    {
        return fail(ENOMEM);
    }
    catch (...)
    {
        return fail(EIO);
    }
}

int mark(int descriptor)
{
    if (static_cast<std::size_t>(descriptor) >= simulated.size())
    {
        simulator().forget(descriptor);
        real_close(descriptor);
        return -EMFILE;
    }
    simulated[static_cast<std::size_t>(descriptor)].store(true, std::memory_order_release);
    return descriptor;
}

// Opens a simulated node; none when the call is for the system.
std::optional<int> open_node(const char* path, int flags) noexcept
{
    auto node = path ? hxasim::node_at(path) : std::nullopt;
    if (!node)
        return std::nullopt;
    bool ours = true;
    int descriptor = guarded(
        [&]
        {
            auto opened = simulator().open(*node, flags);
            ours = opened.has_value();
            return opened && *opened >= 0 ? mark(*opened) : opened.value_or(0);
        });
    return ours ? std::optional(descriptor) : std::nullopt;
}

bool has_mode(int flags) noexcept { return (flags & O_CREAT) != 0 || (flags & O_TMPFILE) == O_TMPFILE; }

template <typename Function> int open_any(Next_Function<Function>& next, const char* path, int flags, mode_t mode)
{
    if (auto opened = open_node(path, flags))
        return *opened;
    auto* real = next.get();
    return real ? real(path, flags, mode) : static_cast<int>(syscall(SYS_openat, AT_FDCWD, path, flags, mode));
}

template <typename Function> int openat_any(Next_Function<Function>& next, int folder, const char* path, int flags, mode_t mode)
{
    if (auto opened = open_node(path, flags))
        return *opened;
    auto* real = next.get();
    return real ? real(folder, path, flags, mode) : static_cast<int>(syscall(SYS_openat, folder, path, flags, mode));
}

} // namespace

#pragma GCC visibility push(default)
extern "C"
{

    int open(const char* path, int flags, ...)
    {
        va_list arguments;
        va_start(arguments, flags);
        mode_t mode = has_mode(flags) ? va_arg(arguments, mode_t) : 0;
        va_end(arguments);
        return open_any(next_open, path, flags, mode);
    }

    int open64(const char* path, int flags, ...)
    {
        va_list arguments;
        va_start(arguments, flags);
        mode_t mode = has_mode(flags) ? va_arg(arguments, mode_t) : 0;
        va_end(arguments);
        return open_any(next_open64, path, flags, mode);
    }

    int openat(int folder, const char* path, int flags, ...)
    {
        va_list arguments;
        va_start(arguments, flags);
        mode_t mode = has_mode(flags) ? va_arg(arguments, mode_t) : 0;
        va_end(arguments);
        return openat_any(next_openat, folder, path, flags, mode);
    }

    int openat64(int folder, const char* path, int flags, ...)
    {
        va_list arguments;
        va_start(arguments, flags);
        mode_t mode = has_mode(flags) ? va_arg(arguments, mode_t) : 0;
        va_end(arguments);
        return openat_any(next_openat64, folder, path, flags, mode);
    }

    // What the fortified headers call for an open without a mode.
    int __open_2(const char* path, int flags)
    {
        if (auto opened = open_node(path, flags))
            return *opened;
        auto* next = next_open_2.get();
        return next ? next(path, flags) : static_cast<int>(syscall(SYS_openat, AT_FDCWD, path, flags, 0));
    }

    int __open64_2(const char* path, int flags)
    {
        if (auto opened = open_node(path, flags))
            return *opened;
        auto* next = next_open64_2.get();
        return next ? next(path, flags) : static_cast<int>(syscall(SYS_openat, AT_FDCWD, path, flags, 0));
    }

    int __openat_2(int folder, const char* path, int flags)
    {
        if (auto opened = open_node(path, flags))
            return *opened;
        auto* next = next_openat_2.get();
        return next ? next(folder, path, flags) : static_cast<int>(syscall(SYS_openat, folder, path, flags, 0));
    }

    int __openat64_2(int folder, const char* path, int flags)
    {
        if (auto opened = open_node(path, flags))
            return *opened;
        auto* next = next_openat64_2.get();
        return next ? next(folder, path, flags) : static_cast<int>(syscall(SYS_openat, folder, path, flags, 0));
    }

    int ioctl(int descriptor, unsigned long code, ...) noexcept
    {
        va_list arguments;
        va_start(arguments, code);
        void* record = va_arg(arguments, void*);
        va_end(arguments);
        if (is_simulated(descriptor))
            return guarded(
                [&]
                {
                    const auto slept = hxasim::take_slept();
                    return -simulator().request(descriptor, static_cast<std::uint32_t>(code), record, slept);
                });
        auto* next = next_ioctl.get();
        return next ? next(descriptor, code, record) : static_cast<int>(syscall(SYS_ioctl, descriptor, code, record));
    }

    // A number is forgotten before it is free: the next open, of anybody, may get it.
    int close(int descriptor)
    {
        if (is_simulated(descriptor))
        {
            simulated[static_cast<std::size_t>(descriptor)].store(false, std::memory_order_release);
            guarded(
                [&]
                {
                    simulator().forget(descriptor);
                    return 0;
                });
        }
        return real_close(descriptor);
    }

} // extern "C"
#pragma GCC visibility pop
