// What the process holds, to be compared before and after work that must leave nothing behind.
#pragma once

#include <chrono>
#include <filesystem>
#include <malloc.h>
#include <ostream>
#include <thread>

namespace sample
{

struct Resources
{
    static std::size_t entries_of(const char* folder)
    {
        const std::filesystem::directory_iterator entries(folder);
        return static_cast<std::size_t>(std::distance(begin(entries), end(entries)));
    }

    std::size_t threads = entries_of("/proc/self/task");
    std::size_t descriptors = entries_of("/proc/self/fd");
    std::size_t heap = mallinfo2().uordblks; // bytes; 0 under sanitizers

    bool operator==(const Resources&) const = default;
};

inline void PrintTo(const Resources& r, std::ostream* out)
{
    *out << r.threads << " threads, " << r.descriptors << " descriptors, " << r.heap << " bytes";
}

// Does the work so many times in a thread of its own: freed blocks that the allocator caches for a thread count as used until
// the thread ends. A thread that was joined may be listed a moment longer.
template <class Work> void repeat(int times, const Work& work)
{
    const Resources before;
    std::thread runner(
        [&]
        {
            for (int i = 0; i < times; ++i)
                work();
        });
    runner.join();
    for (int i = 0; i < 1'000 && Resources().threads != before.threads; ++i)
        std::this_thread::sleep_for(std::chrono::milliseconds(1));
}

} // namespace sample
