// The records of diagnostic runs on 16 converged adapters: 100 service records, each with the port that it tells about. Fails
// when records or their associations cost other requests than one reading of the FC ports.
#include "bench/simulated_host.h"
#include "sim/hxasim.h"

#include <benchmark/benchmark.h>

#include <memory>
#include <string>

namespace
{

using cimserver::Operations;

constexpr std::size_t records = 100;
bool has_failed = false;

std::vector<cimserver::Instance> all_of(Operations& operations, const std::string& class_name)
{
    return operations.enumerate_instances(class_name, true, std::nullopt);
}

// A run of this test leaves two service records. It is tried until the run before it has ended.
void run_on(Operations& operations, const cimserver::Object_Path& test, const cimserver::Object_Path& port)
{
    const cimserver::Value element{CMPI_ref, port};
    std::uint64_t code = 0;
    while (code != 4096)
        code = operations.invoke_method(test, "RunDiagnostic", {{"ManagedElement", element}}).return_value.get<std::uint64_t>();
}

bool is_job_running(Operations& operations)
{
    for (const auto& [name, value] : all_of(operations, "ZEMLAR_ConcreteJob").at(0).properties)
        if (name == "JobState")
            return value.get<std::uint64_t>() == 4;
    return false;
}

void leave_records(Operations& operations)
{
    const auto test = all_of(operations, "ZEMLAR_PCILoopbackDiagnosticTest").at(0).path;
    const auto ports = all_of(operations, "ZEMLAR_FCPort");
    for (std::size_t i = 0; i < records / 2 + 1; ++i)
        run_on(operations, test, ports.at(i % ports.size()).path);
    while (is_job_running(operations))
        continue;
}

// The first run keeps the module in memory, and with it what it knows of the host: there is one for all benchmarks.
Operations& host_with_records()
{
    static bench::Simulated_Host host(R"({"generate": {"kind": "cna", "ports": 2, "adapters": 16}})");
    static const bool has_records = (leave_records(host.operations()), true);
    static_cast<void>(has_records);
    return host.operations();
}

void enumerate(benchmark::State& state, const char* class_name)
{
    Operations& operations = host_with_records();
    const auto requests_of = [&](const char* name)
    {
        const auto before = hxasim::request_count();
        benchmark::DoNotOptimize(all_of(operations, name));
        return hxasim::request_count() - before;
    };
    const auto of_one_reading = requests_of("ZEMLAR_FCPort");
    for (auto _ : state)
    {
        const auto requests = requests_of(class_name);
        if (requests != of_one_reading)
        {
            has_failed = true;
            state.SkipWithError("not the requests of one reading");
            break;
        }
        state.counters["requests"] = static_cast<double>(requests);
    }
    state.counters["instances"] = static_cast<double>(all_of(operations, class_name).size());
}

} // namespace

BENCHMARK_CAPTURE(enumerate, service_records, "ZEMLAR_DiagnosticServiceRecord")->Unit(benchmark::kMicrosecond);
BENCHMARK_CAPTURE(enumerate, their_elements, "ZEMLAR_ServiceRecordAppliesToElement")->Unit(benchmark::kMicrosecond);
BENCHMARK_CAPTURE(enumerate, completion_records, "ZEMLAR_DiagnosticCompletionRecord")->Unit(benchmark::kMicrosecond);

int main(int argc, char** argv)
{
    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
    return has_failed ? 1 : 0;
}
