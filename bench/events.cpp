// Events per second from the drivers to a callback: bursts are queued at one IOC, and the event thread of the access library
// fetches and hands them out.

#include "hxal/hxal.h"
#include "sim/hxasim.h"

#include <benchmark/benchmark.h>

#include <algorithm>
#include <atomic>
#include <cstdint>

namespace
{

std::atomic<std::int64_t> heard = 0;

void count_event(void*, uint32_t, const hxa_ioc_aen_data_t*, hxa_timeval_t)
{
    ++heard;
    heard.notify_one();
}

void raise_burst(std::int64_t size)
{
    for (; size > 0; --size)
        hxasim::raise_event({.category = HXA_AEN_CAT_IOC, .type = HXA_IOC_AEN_HBGOOD});
}

void wait_until_heard(std::int64_t wanted)
{
    for (auto now = heard.load(); now < wanted; now = heard.load())
        heard.wait(now);
}

void events(benchmark::State& state)
{
    hxasim::load("fc-hba");
    hxal_libinit(hxa_aen_app_cim);
    hxal_adapter_scan();
    hxal_ioc_aen_cbhandle_t* registration = nullptr;
    hxal_ioc_aen_register(hxal_ioc_get_list(), count_event, nullptr, &registration);
    hxal_aen_init();

    const auto before = hxasim::request_count();
    heard = 0;
    std::int64_t raised = 0;
    for (auto _ : state)
    {
        raise_burst(state.range(0));
        raised += state.range(0);
        wait_until_heard(raised);
    }
    state.SetItemsProcessed(raised);
    state.counters["requests/event"] =
        static_cast<double>(hxasim::request_count() - before) / static_cast<double>(std::max<std::int64_t>(raised, 1));

    hxal_aen_exit();
    hxal_ioc_aen_unregister(registration);
}

} // namespace

BENCHMARK(events)->Arg(1)->Arg(64)->Arg(10'000)->UseRealTime()->Unit(benchmark::kMicrosecond);

BENCHMARK_MAIN();
