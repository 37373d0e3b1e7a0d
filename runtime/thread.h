// Thread: the platform's threads, started with a context of their own where the calling thread has one.
#pragma once

#include <pthread.h>

namespace zmlr
{

// A handle of one thread; unset until a thread is created into it. Several threads may create threads at once, but not into
// one handle.
//
// Whoever created a joinable thread should join it. A handle that ends, or that is used again, without that lets its
// thread go: the thread runs on, and what the platform keeps of it is freed at its end. Nothing waits for it.
class Thread
{
public:
    using Proc = void* (*)(void* arg);

    Thread() = default;
    ~Thread() { release(); }
    Thread(const Thread&) = delete;
    Thread& operator=(const Thread&) = delete;

    // Runs proc(arg) in a new thread that blocks all signals (blocked_signals.h): 0, or the platform's error number; the handle
    // then keeps what it had. When the calling thread has a context, its thread_create_hook() supplies the new thread's: it is on
    // top of the new thread's stack while proc runs, and the stack must be as proc found it when proc is done. An exception that
    // leaves proc is logged and ends the thread with a null result. Throws std::bad_alloc, and what the hook throws, in the
    // creating thread: nothing was started then.
    static int create_joinable(Thread& thread, Proc proc, void* arg);
    static int create_detached(Thread& thread, Proc proc, void* arg); // no join() for it

    // Ends the calling thread after its context's thread_exit_hook(), destroying what is in its frames: none of them may be
    // noexcept. In a thread that Thread created the context goes too.
    [[noreturn]] static void exit(void* result);

    // Waits for a joinable thread's end, takes its result and leaves the handle unset: 0, or the platform's error number
    // (EINVAL for what is no joinable thread, EDEADLK for the calling thread).
    static int join(Thread& thread, void*& result);

    static Thread self(); // the calling thread, for equal()
    static bool equal(const Thread& a, const Thread& b);

private:
    explicit Thread(pthread_t id) : _id(id) {}
    static int create(Thread& thread, Proc proc, void* arg, bool detached);
    void release();

    pthread_t _id = 0;
    bool _joinable = false; // and neither joined nor let go yet
};

} // namespace zmlr
