// The job of the latest run: there is one at a time.
#pragma once

#include "diagnostics/tested_element.h"
#include "runtime/datetime.h"
#include "runtime/string.h"

#include <chrono>
#include <condition_variable>
#include <functional>
#include <mutex>
#include <optional>

namespace zmlr
{

// CIM_ConcreteJob.JobState
enum Job_State : uint16
{
    JOB_STATE_RUNNING = 4,
    JOB_STATE_COMPLETED = 7
};

struct DiagnosticJob
{
    String name; // the full test name: the job's identity
    Tested_Element element;
    Datetime startTime; // when the job was made
    Job_State jobState = JOB_STATE_RUNNING;
    uint16 percentComplete = 0;
};

// Safe from any thread.
class Job_List
{
public:
    bool isAnyJobRunning();

    // When no job runs, `make_thread` is called, and when it says that the run's thread is made the job takes the place of the
    // one before. All of that happens under one lock: of two starts that arrive together one gets true. False, and nothing
    // changed, otherwise.
    bool start(DiagnosticJob job, const std::function<bool()>& make_thread);

    // Marks the job with that name, in any case of letters, as completed. Needs no memory.
    void updateJobState(const String& name) noexcept;

    // No job starts from now on, the running one is asked to hurry. Waits until it has completed; false when it has not by then.
    bool end(std::chrono::seconds patience);
    bool is_ending();

    std::optional<DiagnosticJob> latest(); // none before the first start

private:
    bool is_running() const { return _job && _job->jobState == JOB_STATE_RUNNING; }

    std::mutex _mutex;
    std::condition_variable _completed;
    std::optional<DiagnosticJob> _job;
    bool _is_ending = false;
};

} // namespace zmlr
