// Threads that take jobs from a queue.
#pragma once

#include <chrono>
#include <condition_variable>
#include <cstddef>
#include <functional>
#include <list>
#include <map>
#include <mutex>
#include <string>
#include <thread>

namespace cimserver
{

// A job that runs longer than `stuck_after` counts as stuck: while others wait, a spare thread takes its place, as long as there
// are spare ones. Those who submit take turns, however many jobs each has.
class Worker_Pool
{
public:
    using Job = std::function<void()>;
    using Clock = std::chrono::steady_clock;

    static constexpr std::chrono::seconds stuck_after{5};

    struct Limits
    {
        unsigned workers;
        unsigned spare; // threads that are started only for stuck ones
        std::size_t waiting;
    };

    // Throws std::system_error when the threads cannot be had.
    explicit Worker_Pool(const Limits& limits);
    ~Worker_Pool(); // stops, waiting for running jobs without bound
    Worker_Pool(const Worker_Pool&) = delete;
    Worker_Pool& operator=(const Worker_Pool&) = delete;

    // False, and the job is not run, when too many jobs wait, memory is out or the pool is stopping.
    bool submit(Job job, const std::string& whose = "") noexcept;

    // Takes no more jobs, runs those that wait, and ends the threads. False when a job still runs at the deadline, or as soon as
    // all that run are stuck: they go on.
    bool stop(Clock::time_point deadline);

private:
    struct Worker
    {
        std::thread thread;
        Clock::time_point since = Clock::time_point::max(); // when its job began
    };

    void start_worker();
    void work(Worker& self);
    Job take_job();
    void oversee();
    std::size_t stuck() const;

    const Limits _limits;
    std::mutex _mutex;
    std::condition_variable _changed;
    std::condition_variable _over;              // for the overseer, whom a job does not concern
    std::multimap<std::size_t, Job> _jobs;      // by the round in which each has its turn
    std::map<std::string, std::size_t> _rounds; // of the last job of each that waits
    std::size_t _round = 0;
    std::size_t _running = 0; // workers, with a job or without
    bool _stopping = false;
    std::list<Worker> _workers;
    std::thread _overseer;
};

} // namespace cimserver
