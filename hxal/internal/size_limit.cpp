#include "hxal/internal/size_limit.h"

#include <cerrno>
#include <ctime>

namespace
{

sigset_t size_limit_signal()
{
    sigset_t signals;
    sigemptyset(&signals);
    sigaddset(&signals, SIGXFSZ);
    return signals;
}

bool is_pending()
{
    sigset_t pending;
    return sigpending(&pending) == 0 && sigismember(&pending, SIGXFSZ) == 1;
}

} // namespace

hxal::Size_Limit_Without_Signal::Size_Limit_Without_Signal() : _was_pending(is_pending())
{
    const sigset_t signals = size_limit_signal();
    pthread_sigmask(SIG_BLOCK, &signals, &_signals_before);
}

// The kernel sends the signal to the thread that writes: one that is pending now, and was not before, is ours.
hxal::Size_Limit_Without_Signal::~Size_Limit_Without_Signal()
{
    const int error = errno;
    const sigset_t signals = size_limit_signal();
    const timespec at_once{};
    if (!_was_pending)
        while (sigtimedwait(&signals, nullptr, &at_once) == -1 && errno == EINTR)
            continue;
    pthread_sigmask(SIG_SETMASK, &_signals_before, nullptr);
    errno = error;
}
