// The generic work on instances that every request does many times: one FC port from its creation to its end, key comparison,
// look-up of a class, and the filter of a property list.
//
// A pass repeats its operation, so that what is measured around a pass does not count. Under callgrind with
// --collect-atstart=no only the operations are counted.

#include "schema/ZEMLAR_FCPort.h"
#include "schema/repository.h"

#include <benchmark/benchmark.h>
#include <valgrind/callgrind.h>

namespace
{

using namespace zmlr;

constexpr int operations_per_pass = 1000; // instructions.py knows it too

template <class Operation> void measure(benchmark::State& state, Operation operation)
{
    for (auto _ : state)
    {
        CALLGRIND_TOGGLE_COLLECT;
        for (int i = 0; i < operations_per_pass; ++i)
            operation();
        CALLGRIND_TOGGLE_COLLECT;
    }
    const auto operations = static_cast<double>(state.iterations()) * operations_per_pass;
    state.counters["time/operation"] = benchmark::Counter(operations, benchmark::Counter::kIsRate | benchmark::Counter::kInvert);
}

Ref<ZEMLAR_FCPort> filled_port()
{
    Ref<ZEMLAR_FCPort> port(ZEMLAR_FCPort::create());
    port->SystemCreationClassName.set("ZEMLAR_ComputerSystem");
    port->SystemName.set("host1.example.com");
    port->CreationClassName.set("ZEMLAR_FCPort");
    port->DeviceID.set("100000051E100000");
    port->Name.set("Zemlar-F25 port 0");
    port->ElementName.set("Zemlar-F25 port 0");
    port->PermanentAddress.set("100000051E100000");
    port->NetworkAddresses.set(Array<String>{"0A0B00"});
    port->OperationalStatus.set(Array<uint16>{2});
    port->SupportedCOS.set(Array<uint16>{2, 3});
    port->ActiveFC4Types.set(Array<uint16>{8});
    port->PortType.set(10);
    port->Speed.set(8'000'000'000);
    port->MaxSpeed.set(16'000'000'000);
    port->EnabledState.set(2);
    return port;
}

void life_of_a_port(benchmark::State& state)
{
    measure(state,
            []
            {
                const Ref<ZEMLAR_FCPort> port = filled_port();
                const Ref<ZEMLAR_FCPort> copied(clone(port.ptr()));
                benchmark::DoNotOptimize(copied.ptr());
            });
}

void key_eq_of_two_ports(benchmark::State& state)
{
    const Ref<ZEMLAR_FCPort> a = filled_port(), b = filled_port();
    measure(state, [&] { benchmark::DoNotOptimize(key_eq(a.ptr(), b.ptr())); });
}

void find_a_class_by_name(benchmark::State& state)
{
    measure(state, [] { benchmark::DoNotOptimize(find_meta_class(&meta_repository(), "ZEMLAR_SCSIProtocolEndpoint")); });
}

void filter_ten_properties(benchmark::State& state)
{
    const Ref<ZEMLAR_FCPort> port = filled_port();
    const char* const names[] = {
        "Name",     "ElementName",  "PortType",          "Speed",          "MaxSpeed", "PermanentAddress",
        "DeviceID", "EnabledState", "OperationalStatus", "ActiveFC4Types", nullptr};
    measure(state, [&] { benchmark::DoNotOptimize(filter_properties(port.ptr(), names, true)); });
}

} // namespace

BENCHMARK(life_of_a_port);
BENCHMARK(key_eq_of_two_ports);
BENCHMARK(find_a_class_by_name);
BENCHMARK(filter_ten_properties);

BENCHMARK_MAIN();
