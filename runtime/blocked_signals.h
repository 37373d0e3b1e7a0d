// Signals are the program's: they are neither for threads of this module nor for processes that it starts.
#pragma once

#include <csignal>
#include <initializer_list>

namespace zmlr
{

// Blocks every signal for the calling thread while it lives, and so for good in a thread or process that starts meanwhile. What a
// fault of the thread's own raises is not blocked: the program's handler may have something to say about it.
class Blocked_Signals
{
public:
    Blocked_Signals()
    {
        sigset_t blocked;
        sigfillset(&blocked);
        for (const int fault : {SIGSEGV, SIGBUS, SIGFPE, SIGILL})
            sigdelset(&blocked, fault);
        pthread_sigmask(SIG_SETMASK, &blocked, &_before);
    }
    ~Blocked_Signals() { pthread_sigmask(SIG_SETMASK, &_before, nullptr); }
    Blocked_Signals(const Blocked_Signals&) = delete;
    Blocked_Signals& operator=(const Blocked_Signals&) = delete;

private:
    sigset_t _before;
};

} // namespace zmlr
