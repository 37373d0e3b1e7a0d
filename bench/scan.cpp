// The adapter scan of the access library on hosts with 1, 16 and 128 IOCs at each of the two drivers.
//
// The number of requests is part of the scan's contract: 3 to a driver and 1 for each of its IOCs, then 2 for each IOC.
//
// Under callgrind with --collect-atstart=no only the scan itself is counted, the simulated drivers with it.

#include "hxal/hxal.h"
#include "sim/hxasim.h"

#include <benchmark/benchmark.h>
#include <valgrind/callgrind.h>

#include <algorithm>
#include <string>

namespace
{

constexpr int most_ports = 8; // of a card

void plug_cards(int iocs)
{
    const int ports = std::min(iocs, most_ports);
    hxasim::load_text(R"({"generate": {"kind": "cna", "ports": )" + std::to_string(ports) + R"(, "adapters": )" +
                      std::to_string(iocs / ports) + "}}");
}

std::uint64_t prescribed_requests(int iocs)
{
    const auto of_one_driver = static_cast<std::uint64_t>(3 + iocs);
    return 2 * of_one_driver + 2 * static_cast<std::uint64_t>(2 * iocs);
}

void scan(benchmark::State& state)
{
    const int iocs = static_cast<int>(state.range(0));
    plug_cards(iocs);
    hxal_libinit(hxa_aen_app_test);
    for (auto _ : state)
    {
        const auto before = hxasim::request_count();
        CALLGRIND_TOGGLE_COLLECT;
        hxal_adapter_scan();
        CALLGRIND_TOGGLE_COLLECT;
        const auto requests = hxasim::request_count() - before;
        if (hxal_ioc_get_num() != 2 * iocs || requests != prescribed_requests(iocs))
        {
            state.SkipWithError("not the requests of a scan");
            break;
        }
        state.counters["requests"] = static_cast<double>(requests);
    }
    const auto scanned = static_cast<double>(state.iterations()) * 2 * iocs;
    state.counters["time/IOC"] = benchmark::Counter(scanned, benchmark::Counter::kIsRate | benchmark::Counter::kInvert);
}

} // namespace

BENCHMARK(scan)->Arg(1)->Arg(16)->Arg(128)->Unit(benchmark::kMicrosecond);

BENCHMARK_MAIN();
