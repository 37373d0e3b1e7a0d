// What a log call costs the code that makes it: one that is suppressed, and one that is written.
//
// Under callgrind with --collect-atstart=no only the calls are counted (and the loop around them).

#include "runtime/log.h"

#include <benchmark/benchmark.h>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <valgrind/callgrind.h>

namespace
{

constexpr const char* log_source = "log_call";
constexpr int calls = 100000; // an iteration makes so many, to be long against the clock's reading

void suppressed_log_call(benchmark::State& state)
{
    for (auto _ : state)
    {
        CALLGRIND_TOGGLE_COLLECT;
        for (int i = 0; i < calls; ++i)
            ZMLR_LOG(zmlr::LL_DBG, "Number of Adapters: %d", i);
        CALLGRIND_TOGGLE_COLLECT;
    }
    state.counters["time/call"] =
        benchmark::Counter(calls, benchmark::Counter::kIsIterationInvariantRate | benchmark::Counter::kInvert);
}

void written_log_call(benchmark::State& state)
{
    int i = 0;
    for (auto _ : state)
        ZMLR_LOG(zmlr::LL_ERR, "Number of Adapters: %d", ++i);
}

} // namespace

BENCHMARK(suppressed_log_call)->Unit(benchmark::kMicrosecond);
BENCHMARK(written_log_call)->Unit(benchmark::kMicrosecond);

int main(int argc, char** argv)
{
    char home[] = "/tmp/zmlr-log-call-XXXXXX";
    if (!mkdtemp(home))
        return 1;
    setenv("HOME", home, 1);
    std::ofstream(std::string(home) + "/.cimplerc") << "LOG_LEVEL = ERR\n";
    zmlr::open_log(".cimple");

    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
    std::filesystem::remove_all(home);
}
