#include "runtime/mutex.h"

#include <gtest/gtest.h>

#include <string>
#include <thread>
#include <vector>

using namespace zmlr;

namespace
{

// Does the work a thousand times in each of four threads.
template <class Work> void in_threads(Work work)
{
    std::vector<std::thread> threads;
    for (int i = 0; i < 4; ++i)
        threads.emplace_back(
            [=]
            {
                for (int k = 0; k < 1000; ++k)
                    work();
            });
    for (std::thread& thread : threads)
        thread.join();
}

TEST(Mutex, is_held_by_one_thread_at_a_time)
{
    for (bool recursive : {true, false})
    {
        Mutex mutex(recursive);
        int count = 0;
        in_threads(
            [&]
            {
                const Auto_Mutex held(mutex);
                ++count;
            });
        EXPECT_EQ(count, 4000);

        const Auto_Mutex held(mutex);
        EXPECT_EQ(mutex.try_lock(), recursive ? 0 : -1);
        if (recursive)
            mutex.unlock();
        std::thread([&] { EXPECT_EQ(mutex.try_lock(), -1); }).join();
    }
}

// What a thread holds is taken in the process that dies: a lock remembers its thread's number, which differs after a fork.
TEST(MutexDeathTest, is_neither_given_back_by_strangers_nor_taken_twice)
{
    const auto report = [](const std::string& verb)
    { return verb + "\\(\\): assert: pthread_mutex_" + verb + "\\(&\\(\\(MutexRep\\*\\)_rep\\)->mutex\\) == 0"; };
    const auto release_from_another_thread = [](Mutex& mutex)
    {
        const Auto_Mutex held(mutex);
        std::thread([&] { mutex.unlock(); }).join();
    };
    for (bool recursive : {true, false})
    {
        Mutex mutex(recursive);
        EXPECT_DEATH(mutex.unlock(), report("unlock"));
        EXPECT_DEATH(release_from_another_thread(mutex), report("unlock"));
    }
    const auto lock_twice = []
    {
        Mutex mutex(false);
        mutex.lock();
        mutex.lock();
    };
    EXPECT_DEATH(lock_twice(), report("lock"));
}

} // namespace
