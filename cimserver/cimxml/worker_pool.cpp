#include "cimserver/cimxml/worker_pool.h"

#include <new>
#include <utility>

namespace cimserver
{

// Delegates, so that the destructor ends the threads there are when one more cannot be had.
Worker_Pool::Worker_Pool(unsigned workers, std::size_t max_waiting) : Worker_Pool(max_waiting)
{
    _workers.reserve(workers);
    for (unsigned i = 0; i < workers; ++i)
    {
        _workers.emplace_back([this] { work(); });
        const std::lock_guard lock(_mutex);
        ++_running;
    }
}

Worker_Pool::~Worker_Pool()
{
    while (!stop(std::chrono::steady_clock::now() + std::chrono::hours(1)))
    {
    }
}

bool Worker_Pool::submit(Job job) noexcept
try
{
    {
        const std::lock_guard lock(_mutex);
        if (_stopping || _jobs.size() >= _max_waiting)
            return false;
        _jobs.push_back(std::move(job));
    }
    _changed.notify_one();
    return true;
}
catch (const std::bad_alloc&)
{
    return false;
}

bool Worker_Pool::stop(std::chrono::steady_clock::time_point deadline)
{
    std::unique_lock lock(_mutex);
    _stopping = true;
    _changed.notify_all();
    if (!_changed.wait_until(lock, deadline, [this] { return _running == 0; }))
        return false;
    lock.unlock();
    for (std::thread& worker : std::exchange(_workers, {}))
        worker.join();
    return true;
}

void Worker_Pool::work()
{
    std::unique_lock lock(_mutex);
    for (;;)
    {
        _changed.wait(lock, [this] { return _stopping || !_jobs.empty(); });
        if (_jobs.empty())
            break;
        const Job job = std::move(_jobs.front());
        _jobs.pop_front();
        lock.unlock();
        job();
        lock.lock();
    }
    --_running;
    _changed.notify_all();
}

} // namespace cimserver
