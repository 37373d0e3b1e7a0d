// Loading the module: mapping and binding it, the probe of the drivers, and unloading it again.

#include "bench/simulated_host.h"
#include "sim/hxasim.h"

#include <benchmark/benchmark.h>
#include <dlfcn.h>

namespace
{

void load_module(benchmark::State& state)
{
    hxasim::load_text(bench::two_port_hbas(static_cast<int>(state.range(0))));
    for (auto _ : state)
    {
        void* module = dlopen(bench::module_path, RTLD_NOW | RTLD_GLOBAL);
        if (!module)
        {
            state.SkipWithError(dlerror());
            break;
        }
        dlclose(module);
    }
    state.counters["requests"] =
        benchmark::Counter(static_cast<double>(hxasim::request_count()), benchmark::Counter::kAvgIterations);
}

} // namespace

BENCHMARK(load_module)->Arg(0)->Arg(1)->Arg(16)->Arg(64)->Unit(benchmark::kMicrosecond);

BENCHMARK_MAIN();
