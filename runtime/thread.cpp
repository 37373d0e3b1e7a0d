#include "runtime/thread.h"

#include "runtime/assert.h"
#include "runtime/blocked_signals.h"
#include "runtime/log.h"
#include "runtime/thread_context.h"

#include <cerrno>
#include <cxxabi.h>
#include <exception>
#include <memory>
#include <utility>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "Thread";

struct Arg
{
    Thread::Proc proc;
    void* arg;
    std::unique_ptr<Thread_Context> context;
};

// A thread's own context, on its stack for as long as the thread runs, by whatever way it ends.
class Own_Context
{
public:
    explicit Own_Context(std::unique_ptr<Thread_Context> context) : _context(std::move(context))
    {
        if (!_context)
            return;
        Thread_Context::push(_context.get());
        _context->thread_start_hook();
    }

    ~Own_Context()
    {
        if (!_context)
            return;
        check(_context.get() == Thread_Context::top(), "context == Thread_Context::top()");
        Thread_Context::pop();
    }

    Own_Context(const Own_Context&) = delete;
    Own_Context& operator=(const Own_Context&) = delete;

    void thread_exit_hook()
    {
        if (_context)
            _context->thread_exit_hook();
    }

private:
    std::unique_ptr<Thread_Context> _context;
};

void* run(Thread::Proc proc, void* arg)
{
    try
    {
        return proc(arg);
    }
    catch (const abi::__forced_unwind&)
    {
        throw; // the platform ends the thread: Thread::exit()
    }
    catch (const std::exception& exception)
    {
        ZMLR_LOG(LL_ERR, "Thread ended by an exception: %s", exception.what());
    }
    catch (...)
    {
        ZMLR_LOG(LL_ERR, "Thread ended by an exception");
    }
    return nullptr;
}

void* start(void* data)
{
    std::unique_ptr<Arg> record(static_cast<Arg*>(data));
    const Thread::Proc proc = record->proc;
    void* const arg = record->arg;
    Own_Context context(std::move(record->context));
    record.reset();

    void* const result = run(proc, arg);
    context.thread_exit_hook();
    return result;
}

int start_with_blocked_signals(pthread_t& id, const pthread_attr_t& attributes, Arg* record)
{
    const Blocked_Signals blocked;
    return pthread_create(&id, &attributes, start, record);
}

} // namespace

int Thread::create(Thread& thread, Proc proc, void* arg, bool detached)
{
    Thread_Context* const creator = Thread_Context::top();
    auto record = std::make_unique<Arg>();
    record->proc = proc;
    record->arg = arg;
    if (creator)
        record->context.reset(creator->thread_create_hook(arg));

    pthread_attr_t attributes;
    pthread_attr_init(&attributes);
    pthread_attr_setdetachstate(&attributes, detached ? PTHREAD_CREATE_DETACHED : PTHREAD_CREATE_JOINABLE);
    pthread_t id = 0;
    const int error = start_with_blocked_signals(id, attributes, record.get());
    pthread_attr_destroy(&attributes);
    if (error != 0)
        return error;

    record.release(); // the new thread's
    thread.release();
    thread._id = id;
    thread._joinable = !detached;
    return 0;
}

int Thread::create_joinable(Thread& thread, Proc proc, void* arg) { return create(thread, proc, arg, false); }
int Thread::create_detached(Thread& thread, Proc proc, void* arg) { return create(thread, proc, arg, true); }

void Thread::exit(void* result)
{
    if (Thread_Context* context = Thread_Context::top())
        context->thread_exit_hook();
    pthread_exit(result);
}

int Thread::join(Thread& thread, void*& result)
{
    if (!thread._joinable)
        return EINVAL;
    const int error = pthread_join(thread._id, &result);
    if (error != 0)
        return error;
    thread._id = 0;
    thread._joinable = false;
    return 0;
}

Thread Thread::self() { return Thread(pthread_self()); }
bool Thread::equal(const Thread& a, const Thread& b) { return pthread_equal(a._id, b._id) != 0; }

// Not a join: the thread may wait for a lock that the caller holds.
void Thread::release()
{
    if (_joinable)
        pthread_detach(_id);
    _id = 0;
    _joinable = false;
}

} // namespace zmlr
