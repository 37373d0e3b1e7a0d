// The inventory through the broker, for every class that has instances: all of them, and one by its path, on hosts of 1 to 64
// adapters; all that is associated with one controller and with the host; then the units behind one target. Driver requests,
// memory above idle and time, each per instance.
//
// Under callgrind each benchmark dumps its instructions by its name; inventory_table.py makes a table of all of it.

#include "bench/meter.h"
#include "bench/simulated_host.h"
#include "cimserver/broker/objects.h"
#include "cimserver/operations/provider_call.h"
#include "sim/hxasim.h"

#include <benchmark/benchmark.h>
#include <malloc.h>

#include <string>
#include <vector>

namespace
{

// Two-port CNAs; behind each port an array with four disks and a tape drive.
std::string host_of_adapters(std::int64_t adapters)
{
    const std::string adapter =
        R"({"kind": "cna", "ports": [{"remote_ports": [{"luns": {"count": 4}}, {"luns": {"type": "tape"}}]},
                                                             {"remote_ports": [{"luns": {"count": 4}}, {"luns": {"type": "tape"}}]}]})";
    std::string list = adapter;
    for (std::int64_t i = 1; i < adapters; ++i)
        list += "," + adapter;
    return R"({"adapters": [)" + list + "]}";
}

// One port and two equal targets.
std::string host_of_luns(std::int64_t luns)
{
    const std::string target = R"({"luns": {"count": )" + std::to_string(luns / 2) + "}}";
    return R"({"adapters": [{"kind": "fc-hba", "ports": [{"remote_ports": [)" + target + "," + target + "]}]}]}";
}

using Host_Text = std::string (*)(std::int64_t size);
using Instances = std::vector<cimserver::Instance>;

Instances all_of(cimserver::Operations& operations, const std::string& class_name)
{
    return operations.enumerate_instances(class_name, true, std::nullopt);
}

Instances enumerate(cimserver::Operations& operations, const cimserver::Object_Path& path)
{
    return all_of(operations, path.class_name);
}

Instances get(cimserver::Operations& operations, const cimserver::Object_Path& path)
{
    return {operations.get_instance(path, std::nullopt)};
}

Instances traverse(cimserver::Operations& operations, const cimserver::Object_Path& path)
{
    return operations.associators(path, {}, std::nullopt);
}

// What is measured: an operation of the server, and the provider's function behind it if it is one.
struct Work
{
    Instances (*ask)(cimserver::Operations&, const cimserver::Object_Path&);
    decltype(&CMPIInstanceMIFT::getInstance) function;
    bool of_one; // with the path of an instance
};

constexpr Work enumeration = {enumerate, &CMPIInstanceMIFT::enumerateInstances, false};
constexpr Work one_by_path = {get, &CMPIInstanceMIFT::getInstance, true};
constexpr Work traversal = {traverse, nullptr, true};

// A server that keeps nothing of what it is given.
class Passing_Sink : public cimserver::Result_Sink
{
    void take_instance(const cimserver::Instance_Object&) override {}
};

// The peak of what the module and the broker's objects take, without an answer that a server collects.
std::size_t module_peak(cimserver::Module& module, const cimserver::Object_Path& path, const Work& work)
{
    const cimserver::Class_Entry& provider = *module.repository().find(path.class_name);
    CMPIInstanceMI* mi = module.instance_mi(provider);
    Passing_Sink sink;
    const bench::Memory_Meter meter;
    cimserver::Provider_Call(module, provider, "", path, sink).run(mi, mi->ft->*work.function, nullptr);
    return meter.peak();
}

// Every request starts as it does in a server, which wrote the answer before as one long text: for a block of that size the
// allocator puts together what is free.
void put_free_blocks_together()
{
    const std::string text(100'000, ' ');
    benchmark::DoNotOptimize(text.data());
}

// The one instance is that in the middle.
void measure(benchmark::State& state, const std::string& name, const std::string& class_name, Host_Text host_text,
             const Work& work)
{
    malloc_trim(0); // of the benchmark before
    bench::Simulated_Host host(host_text(state.range(0)));
    const Instances all = all_of(host.operations(), class_name); // the first request makes the provider
    cimserver::Object_Path path = all.at(all.size() / 2).path;
    if (!work.of_one)
        path.keys.clear();
    work.ask(host.operations(), path);

    const auto before = hxasim::request_count();
    std::size_t instances = 0;
    std::size_t peak = 0;
    {
        const bench::Memory_Meter meter;
        const Instances answer = work.ask(host.operations(), path);
        peak = meter.peak();
        instances = answer.size();
    }
    const auto requests = hxasim::request_count() - before;

    for (auto _ : state)
    {
        put_free_blocks_together();
        const bench::Counted counted;
        work.ask(host.operations(), path);
    }
    const std::string whole_name = name + "/" + std::to_string(state.range(0));
    CALLGRIND_DUMP_STATS_AT(whole_name.c_str());

    const auto per_instance = [&](auto total) { return static_cast<double>(total) / static_cast<double>(instances); };
    state.counters["instances"] = static_cast<double>(instances);
    state.counters["requests"] = static_cast<double>(requests);
    state.counters["requests/instance"] = per_instance(requests);
    state.counters["peak/instance"] = per_instance(peak);
    if (work.function)
        state.counters["module peak/instance"] = per_instance(module_peak(host.module(), path, work));
    state.counters["time/instance"] = benchmark::Counter(
        static_cast<double>(instances), benchmark::Counter::kIsIterationInvariantRate | benchmark::Counter::kInvert);
}

void add(const std::string& name, const std::string& class_name, Host_Text host_text, const Work& work,
         const std::vector<std::int64_t>& sizes)
{
    auto* added = benchmark::RegisterBenchmark(name.c_str(), [name, class_name, host_text, work](benchmark::State& state)
                                               { measure(state, name, class_name, host_text, work); });
    for (const std::int64_t size : sizes)
        added->Arg(size);
    added->Unit(benchmark::kMicrosecond);
}

std::vector<std::string> classes_with_instances()
{
    bench::Simulated_Host host(host_of_adapters(1));
    std::vector<std::string> classes;
    for (const zmlr::Meta_Class* meta_class : host.operations().enumerate_classes("", true))
    {
        const std::string name = meta_class->name;
        if (name.starts_with("ZEMLAR_") && !all_of(host.operations(), name).empty())
            classes.push_back(name);
    }
    return classes;
}

} // namespace

int main(int argc, char** argv)
{
    const std::vector<std::string> classes = classes_with_instances();
    for (const std::string& name : classes)
        add("enumerate/" + name, name, host_of_adapters, enumeration, {1, 4, 16, 64});
    for (const std::string& name : classes)
        add("get/" + name, name, host_of_adapters, one_by_path, {1, 4, 16, 64});
    for (const char* name : {"ZEMLAR_PortController", "ZEMLAR_ComputerSystem"})
        add(std::string("associators/") + name, name, host_of_adapters, traversal, {1, 4, 16, 64});
    add("enumerate_luns", "ZEMLAR_StorageExtent", host_of_luns, enumeration, {10, 1000, 10000});
    add("get_lun", "ZEMLAR_StorageExtent", host_of_luns, one_by_path, {10, 1000, 10000});

    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
}
