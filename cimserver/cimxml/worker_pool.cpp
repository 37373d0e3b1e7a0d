#include "cimserver/cimxml/worker_pool.h"

#include <algorithm>
#include <exception>
#include <new>
#include <utility>

namespace cimserver
{

Worker_Pool::Worker_Pool(const Limits& limits) : _limits(limits)
{
    try
    {
        const std::lock_guard lock(_mutex);
        for (unsigned i = 0; i < limits.workers; ++i)
            start_worker();
        if (limits.spare > 0)
            _overseer = std::thread([this] { oversee(); });
    }
    catch (...)
    {
        stop(Clock::now() + std::chrono::hours(1));
        throw;
    }
}

Worker_Pool::~Worker_Pool()
{
    while (!stop(Clock::now() + std::chrono::hours(1)))
    {
    }
}

void Worker_Pool::start_worker()
{
    Worker& worker = _workers.emplace_back();
    try
    {
        worker.thread = std::thread([this, &worker] { work(worker); });
        ++_running;
    }
    catch (...)
    {
        _workers.pop_back();
        throw;
    }
}

bool Worker_Pool::submit(Job job, const std::string& whose) noexcept
try
{
    {
        const std::lock_guard lock(_mutex);
        if (_stopping || _jobs.size() >= _limits.waiting)
            return false;
        const auto [last, fresh] = _rounds.try_emplace(whose, _round);
        const std::size_t round = fresh ? _round : std::max(_round, last->second + 1);
        _jobs.emplace(round, std::move(job));
        last->second = round;
    }
    _changed.notify_one();
    return true;
}
catch (const std::bad_alloc&)
{
    return false;
}

// Looked at ten times a second: that a job becomes stuck is told by nobody.
bool Worker_Pool::stop(Clock::time_point deadline)
{
    std::unique_lock lock(_mutex);
    _stopping = true;
    _changed.notify_all();
    _over.notify_all();
    while (_running > 0)
    {
        _changed.wait_until(lock, std::min(deadline, Clock::now() + std::chrono::milliseconds(100)));
        if (_running > 0 && (Clock::now() >= deadline || stuck() == _running))
            return false;
    }
    lock.unlock();
    for (Worker& worker : std::exchange(_workers, {}))
        worker.thread.join();
    if (_overseer.joinable())
        _overseer.join();
    return true;
}

void Worker_Pool::work(Worker& self)
{
    std::unique_lock lock(_mutex);
    for (;;)
    {
        _changed.wait(lock, [this] { return _stopping || !_jobs.empty(); });
        if (_jobs.empty())
            break;
        const Job job = take_job();
        self.since = Clock::now();
        lock.unlock();
        job();
        lock.lock();
        self.since = Clock::time_point::max();
    }
    --_running;
    _changed.notify_all();
}

Worker_Pool::Job Worker_Pool::take_job()
{
    auto next = _jobs.extract(_jobs.begin());
    _round = next.key();
    if (_jobs.empty())
        _rounds.clear();
    return std::move(next.mapped());
}

std::size_t Worker_Pool::stuck() const
{
    const auto now = Clock::now();
    const auto is_stuck = [now](const Worker& worker) { return worker.since < now && now - worker.since >= stuck_after; };
    return static_cast<std::size_t>(std::ranges::count_if(_workers, is_stuck));
}

void Worker_Pool::oversee()
{
    std::unique_lock lock(_mutex);
    while (!_over.wait_for(lock, std::chrono::seconds(1), [this] { return _stopping; }))
        try
        {
            const std::size_t spare = _workers.size() - _limits.workers;
            if (!_jobs.empty() && stuck() > spare && spare < _limits.spare)
                start_worker();
        }
        catch (const std::exception&)
        {
            // No thread or memory for one: it is tried again.
        }
}

} // namespace cimserver
