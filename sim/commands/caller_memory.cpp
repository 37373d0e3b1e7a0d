#include "sim/commands/caller_memory.h"

#include <sys/uio.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>

namespace hxasim
{

namespace
{

using Transfer = ssize_t (*)(pid_t, const iovec*, unsigned long, const iovec*, unsigned long, unsigned long);

enum class Outcome
{
    done,
    bad_address,
    not_available
};

Outcome transfer(Transfer call, void* here, void* there, std::size_t size)
{
    iovec local{.iov_base = here, .iov_len = size};
    iovec remote{.iov_base = there, .iov_len = size};
    auto moved = call(getpid(), &local, 1, &remote, 1, 0);
    if (moved < 0 && errno != EFAULT)
        return Outcome::not_available;
    return moved == static_cast<ssize_t>(size) ? Outcome::done : Outcome::bad_address;
}

} // namespace

// A sandbox may forbid the calls that check addresses; then a plain copy has to do.
bool copy_from_caller(std::span<std::uint8_t> to, const void* from)
{
    if (!from)
        return to.empty();
    auto outcome = transfer(process_vm_readv, to.data(), const_cast<void*>(from), to.size());
    if (outcome == Outcome::not_available)
        std::memcpy(to.data(), from, to.size());
    return outcome != Outcome::bad_address;
}

bool copy_to_caller(void* to, std::span<const std::uint8_t> from)
{
    if (!to)
        return from.empty();
    auto outcome = transfer(process_vm_writev, const_cast<std::uint8_t*>(from.data()), to, from.size());
    if (outcome == Outcome::not_available)
        std::memcpy(to, from.data(), from.size());
    return outcome != Outcome::bad_address;
}

} // namespace hxasim
