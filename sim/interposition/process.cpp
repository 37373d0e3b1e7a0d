#include "sim/interposition/process.h"

#include "sim/control/control_requests.h"
#include "sim/control/control_server.h"

#include <pthread.h>

#include <cstdio>
#include <cstdlib>
#include <exception>

namespace hxasim
{

namespace
{

constexpr const char* control_variable = "HXASIM_CONTROL";

struct Process
{
    Process();
    void serve_as_the_environment_says();

    Simulator simulator;
    Control_Server control{[](std::string_view line) { return answer_control(hxasim::simulator(), line); }};
};

Process& process()
{
    static Process& the_one = *new Process;
    return the_one;
}

void before_fork()
{
    process().control.before_fork();
    process().simulator.before_fork();
}

void after_fork_in_parent()
{
    process().simulator.after_fork_in_parent();
    process().control.after_fork_in_parent();
}

void after_fork_in_child()
{
    process().simulator.after_fork_in_child();
    process().control.after_fork_in_child();
}

Process::Process()
{
    pthread_atfork(before_fork, after_fork_in_parent, after_fork_in_child);
    serve_as_the_environment_says();
}

void Process::serve_as_the_environment_says()
{
    const char* path = secure_getenv(control_variable);
    if (!path || *path == '\0')
        return;
    try
    {
        control.serve(path);
    }
    catch (const std::exception& error)
    {
        std::fprintf(stderr, "hxasim: %s=%s: %s\n", control_variable, path, error.what());
    }
}

} // namespace

Simulator& simulator() { return process().simulator; }

void serve_control_at(const std::string& path) { process().control.serve(path); }

} // namespace hxasim
