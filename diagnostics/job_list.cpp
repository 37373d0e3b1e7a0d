#include "diagnostics/job_list.h"

#include "runtime/trace.h"

#include <utility>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "DiagnosticHelper";

} // namespace

bool Job_List::isAnyJobRunning()
{
    const Scope_Trace trace(log_source);
    const std::lock_guard guard(_mutex);
    return is_running();
}

// The run's thread waits for the lock before it changes its job.
bool Job_List::start(DiagnosticJob job, const std::function<bool()>& make_thread)
{
    const Scope_Trace trace(log_source, "addDiagnosticJob");
    const std::lock_guard guard(_mutex);
    if (_is_ending || is_running() || !make_thread())
        return false;
    _job = std::move(job);
    return true;
}

void Job_List::updateJobState(const String& name) noexcept
{
    const Scope_Trace trace(log_source);
    const std::lock_guard guard(_mutex);
    if (!_job || !_job->name.equali(name))
        return;
    _job->jobState = JOB_STATE_COMPLETED;
    _job->percentComplete = 100;
    _completed.notify_all();
}

// By the wall clock: the thread sanitizer of clang 14 does not see a lock that is taken again by the steady one. In slices:
// a clock that is set forward ends one of them early, and not the whole; the end of the run wakes in any case.
bool Job_List::end(std::chrono::seconds patience)
{
    constexpr std::chrono::milliseconds slice(100);
    std::unique_lock lock(_mutex);
    _is_ending = true;
    for (auto left = patience / slice; left > 0 && is_running(); --left)
        _completed.wait_until(lock, std::chrono::system_clock::now() + slice);
    return !is_running();
}

bool Job_List::is_ending()
{
    const std::lock_guard guard(_mutex);
    return _is_ending;
}

std::optional<DiagnosticJob> Job_List::latest()
{
    const std::lock_guard guard(_mutex);
    return _job;
}

} // namespace zmlr
