#include "diagnostics/exit_hook.h"

#include "runtime/log.h"

#include <unistd.h>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "DiagnosticHelper";
constexpr std::chrono::seconds patience{10};

class Ending
{
public:
    explicit Ending(Job_List& jobs) : _jobs(jobs), _process(::getpid()) {}

    // A process that was forked off has no run.
    ~Ending()
    {
        if (::getpid() == _process && !_jobs.end(patience))
            ZMLR_LOG(LL_ERR, "The process ends while a diagnostic test runs; what it took out of service stays out");
    }

    Ending(const Ending&) = delete;
    Ending& operator=(const Ending&) = delete;

private:
    Job_List& _jobs;
    const pid_t _process;
};

} // namespace

void hook_exit(Job_List& jobs)
{
    static const Ending ending(jobs); // younger, so gone earlier, than everything that exists before the first run
}

} // namespace zmlr
