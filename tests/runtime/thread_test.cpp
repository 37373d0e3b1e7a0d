#include "runtime/thread.h"
#include "runtime/time.h"
#include "tests/runtime/silent_context.h"

#include <gtest/gtest.h>

#include <atomic>
#include <cerrno>
#include <csignal>
#include <mutex>
#include <stdexcept>
#include <string>
#include <thread>
#include <utility>

using namespace zmlr;

namespace
{

// What happened to contexts, in its order, whichever thread it happened in: at any time only one of them can touch a context.
using Events = std::string;

// Serves threads; there is no server behind it.
class Recording_Context : public Silent_Context
{
public:
    explicit Recording_Context(Events& events, Thread_Context* child = nullptr) : _events(events), _child(child) {}
    ~Recording_Context() override { _events += "delete "; }

    Thread_Context* thread_create_hook(void*) override
    {
        _events += "create ";
        return std::exchange(_child, nullptr);
    }
    void thread_start_hook() noexcept override { _events += top() == this ? "start " : "start-elsewhere "; }
    void thread_exit_hook() noexcept override { _events += top() == this ? "exit " : "exit-elsewhere "; }

private:
    Events& _events;
    Thread_Context* _child;
};

// Runs a procedure in a joined thread and returns its result.
void* in_thread(Thread::Proc proc, void* arg = nullptr)
{
    Thread thread;
    void* result = nullptr;
    EXPECT_EQ(Thread::create_joinable(thread, proc, arg), 0);
    EXPECT_EQ(Thread::join(thread, result), 0);
    return result;
}

void* top_of_stack(void*) { return Thread_Context::top(); }

TEST(Thread_Context, each_thread_has_its_own_stack)
{
    Events events;
    Recording_Context lower(events), upper(events);
    Thread_Context::push(&lower);
    Thread_Context::push(&upper);
    EXPECT_EQ(Thread_Context::top(), &upper);
    EXPECT_EQ(in_thread(top_of_stack), nullptr) << "the hook supplied none";
    Thread_Context::pop();
    EXPECT_EQ(Thread_Context::top(), &lower);
    Thread_Context::pop();
    EXPECT_EQ(Thread_Context::top(), nullptr);
    EXPECT_EQ(in_thread(top_of_stack), nullptr) << "there is none to supply one";
}

TEST(Thread, runs_in_the_context_that_its_creator_supplies)
{
    static int value;
    const std::pair<Thread::Proc, void*> cases[] = {
        {[](void* arg) { return arg; }, &value},
        {[](void* arg) -> void* { Thread::exit(arg); }, &value},
        {[](void*) -> void* { throw std::runtime_error("no"); }, nullptr},
        {[](void*) -> void* { throw 1; }, nullptr},
    };
    for (const auto& c : cases)
    {
        Events events;
        Recording_Context creator(events, new Recording_Context(events));
        Thread_Context::push(&creator);
        EXPECT_EQ(in_thread(c.first, &value), c.second);
        Thread_Context::pop();
        EXPECT_EQ(events, "create start exit delete ") << "case " << &c - cases;
    }
}

TEST(ThreadDeathTest, must_leave_its_stack_of_contexts_as_it_was)
{
    const auto leave_one_more = []
    {
        static Events events;
        static Recording_Context creator(events, new Recording_Context(events)), forgotten(events);
        Thread_Context::push(&creator);
        in_thread(
            [](void*) -> void*
            {
                Thread_Context::push(&forgotten);
                return nullptr;
            });
    };
    EXPECT_DEATH(leave_one_more(), "assert: context == Thread_Context::top\\(\\)");
    EXPECT_DEATH(Thread_Context::pop(), "assert: context != 0");
}

TEST(Thread, that_cannot_be_created_leaves_nothing_behind)
{
    pthread_attr_t usual, endless;
    ASSERT_EQ(pthread_getattr_default_np(&usual), 0);
    pthread_attr_init(&endless);
    pthread_attr_setstacksize(&endless, std::size_t{1} << 46);
    ASSERT_EQ(pthread_setattr_default_np(&endless), 0);

    Events events;
    Recording_Context creator(events, new Recording_Context(events));
    Thread_Context::push(&creator);
    Thread thread;
    EXPECT_EQ(Thread::create_joinable(thread, top_of_stack, nullptr), EAGAIN);
    Thread_Context::pop();
    pthread_setattr_default_np(&usual);
    EXPECT_EQ(events, "create delete ");
    void* result = nullptr;
    EXPECT_EQ(Thread::join(thread, result), EINVAL);
}

TEST(Thread, knows_itself_and_is_joined_once)
{
    static Thread creator = Thread::self();
    EXPECT_TRUE(Thread::equal(creator, Thread::self()));
    EXPECT_FALSE(Thread::equal(creator, Thread()));
    EXPECT_EQ(in_thread([](void*) -> void* { return Thread::equal(creator, Thread::self()) ? &creator : nullptr; }), nullptr);

    Thread thread;
    void* result = nullptr;
    EXPECT_EQ(Thread::join(thread, result), EINVAL) << "unset";
    ASSERT_EQ(Thread::create_joinable(thread, top_of_stack, nullptr), 0);
    EXPECT_EQ(Thread::join(thread, result), 0);
    EXPECT_EQ(Thread::join(thread, result), EINVAL) << "joined";
    ASSERT_EQ(Thread::create_detached(thread, top_of_stack, nullptr), 0);
    EXPECT_EQ(Thread::join(thread, result), EINVAL) << "detached";
}

TEST(Thread, leaves_signals_to_the_program)
{
    const Thread::Proc blocks_them = [](void*) -> void*
    {
        static sigset_t blocked;
        pthread_sigmask(SIG_BLOCK, nullptr, &blocked);
        return sigismember(&blocked, SIGTERM) ? &blocked : nullptr;
    };
    EXPECT_NE(in_thread(blocks_them), nullptr);
    EXPECT_EQ(blocks_them(nullptr), nullptr) << "the creator gets them as before";
}

// A thread that cannot end before the lock is given back is let go by its handle's next use: nobody waits for it. The thread
// sanitizer reports it if it were leaked.
TEST(Thread, used_again_lets_the_thread_before_go)
{
    static std::mutex mutex;
    static std::atomic<int> ended = 0;
    const Thread::Proc proc = [](void*) -> void*
    {
        const std::lock_guard guard(mutex);
        ++ended;
        return nullptr;
    };
    {
        Thread thread;
        const std::lock_guard held(mutex);
        for (int i = 0; i < 3; ++i)
            ASSERT_EQ(Thread::create_joinable(thread, proc, nullptr), 0);
    }
    while (ended < 3)
        Time::sleep(Time::MSEC);
}

TEST(Time, sleeps_its_time_through_signals)
{
    static const pthread_t sleeper = pthread_self();
    struct sigaction old, action{};
    action.sa_handler = [](int) {};
    sigaction(SIGUSR1, &action, &old);

    const uint64 begin = Time::now();
    std::thread disturber(
        []
        {
            for (int i = 0; i < 10; ++i, Time::sleep(2 * Time::MSEC))
                pthread_kill(sleeper, SIGUSR1);
        });
    Time::sleep(50 * Time::MSEC);
    EXPECT_GE(Time::now() - begin, 50 * Time::MSEC);
    disturber.join();
    sigaction(SIGUSR1, &old, nullptr);
}

} // namespace
