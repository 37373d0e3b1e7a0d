// All ZEMLAR_FCPort instances through the broker, on hosts of 1 to 64 two-port adapters.
//
// Under callgrind with --collect-atstart=no only the enumeration itself is counted.

#include "bench/simulated_host.h"
#include "sim/hxasim.h"

#include <benchmark/benchmark.h>
#include <valgrind/callgrind.h>

namespace
{

std::size_t enumerate(cimserver::Operations& operations)
{
    return operations.enumerate_instances("ZEMLAR_FCPort", true, std::nullopt).size();
}

void enumerate_fc_ports(benchmark::State& state)
{
    bench::Simulated_Host host(static_cast<int>(state.range(0)));
    enumerate(host.operations()); // the first request makes the provider
    const auto before = hxasim::request_count();

    std::size_t ports = 0;
    for (auto _ : state)
    {
        CALLGRIND_TOGGLE_COLLECT;
        ports += enumerate(host.operations());
        CALLGRIND_TOGGLE_COLLECT;
    }

    const auto requests = static_cast<double>(hxasim::request_count() - before);
    state.counters["ports"] = static_cast<double>(ports) / static_cast<double>(state.iterations());
    state.counters["requests/port"] = requests / static_cast<double>(ports);
    state.counters["time/port"] =
        benchmark::Counter(static_cast<double>(ports), benchmark::Counter::kIsRate | benchmark::Counter::kInvert);
}

} // namespace

BENCHMARK(enumerate_fc_ports)->Arg(1)->Arg(4)->Arg(16)->Arg(64)->Unit(benchmark::kMicrosecond);

BENCHMARK_MAIN();
