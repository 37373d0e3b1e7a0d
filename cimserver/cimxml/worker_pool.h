// A fixed number of threads that run jobs from a bounded queue.
#pragma once

#include <chrono>
#include <condition_variable>
#include <cstddef>
#include <deque>
#include <functional>
#include <mutex>
#include <thread>
#include <vector>

namespace cimserver
{

// A job must not throw. All functions may be called from any thread but a worker's own.
class Worker_Pool
{
public:
    using Job = std::function<void()>;

    Worker_Pool(unsigned workers, std::size_t max_waiting);
    ~Worker_Pool(); // waits for the accepted jobs, without bound
    Worker_Pool(const Worker_Pool&) = delete;
    Worker_Pool& operator=(const Worker_Pool&) = delete;

    // False, and the job is not taken, when max_waiting jobs wait already, memory is out or the pool has been stopped.
    bool submit(Job job) noexcept;

    // Takes no more jobs and runs those accepted. False when they had not finished by the deadline; they go on, and stop()
    // may be called again.
    bool stop(std::chrono::steady_clock::time_point deadline);

private:
    explicit Worker_Pool(std::size_t max_waiting) : _max_waiting(max_waiting) {}
    void work();

    std::mutex _mutex;
    std::condition_variable _changed;
    std::deque<Job> _jobs;
    std::size_t _max_waiting;
    std::size_t _running = 0; // workers that have not ended
    bool _stopping = false;
    std::vector<std::thread> _workers;
};

} // namespace cimserver
