// What joining costs beside reading what is joined: an association class whole, and its sides alone, of 12,800 units behind
// 8 targets of each of 16 ports.
//
// Under callgrind each benchmark dumps its instructions by its name.

#include "bench/meter.h"
#include "hxal/hxal.h"
#include "providers/joining.h"
#include "providers/joins_inventory.h"
#include "sim/hxasim.h"

#include <benchmark/benchmark.h>

#include <cstdlib>
#include <string>
#include <vector>

using namespace zmlr;

namespace
{

// The driver is probed before main().
[[gnu::constructor(101)]] void choose_a_host_with_a_driver() { setenv("HXASIM_SCENARIO", "mixed", 1); }

std::string repeated(const std::string& text, int count)
{
    std::string list = text;
    for (int i = 1; i < count; i++)
        list += "," + text;
    return "[" + list + "]";
}

void plug_many_units()
{
    const std::string port = R"({"remote_ports": )" + repeated(R"({"luns": {"count": 100}})", 8) + "}";
    const std::string adapter = R"({"kind": "fc-hba", "ports": )" + repeated(port, 2) + "}";
    hxasim::load_text(R"({"adapters": )" + repeated(adapter, 8) + "}");
    hxal_adapter_scan();
}

std::size_t join_all(const Join& row)
{
    std::size_t count = 0;
    const auto drop = [&count](Instance* association)
    {
        unref(association);
        count++;
        return true;
    };
    Joining joining(row, "bench", drop);
    row.match(joining);
    return count;
}

std::size_t read_sides(const Join& row)
{
    const Inventory_Request request;
    std::vector<Instance_Array> sides;
    for (const Side& side : row.sides)
    {
        if (side.ask)
            sides.push_back(side.ask(request));
    }
    return sides.size();
}

void add(const std::string& name, const Join& row, std::size_t (*work)(const Join& row))
{
    const auto measure = [name, &row, work](benchmark::State& state)
    {
        std::size_t count = 0;
        for (auto _ : state)
        {
            const bench::Counted counted;
            count = work(row);
        }
        CALLGRIND_DUMP_STATS_AT(name.c_str());
        state.counters["count"] = static_cast<double>(count);
    };
    benchmark::RegisterBenchmark(name.c_str(), measure)->Unit(benchmark::kMillisecond);
}

} // namespace

int main(int argc, char** argv)
{
    plug_many_units();
    for (const Meta_Class* meta_class : {of<ZEMLAR_StorageResourcesSystemDevice>, of<ZEMLAR_SCSIInitiatorTargetLogicalUnitPath>})
    {
        for (const Join& row : inventory_joins)
        {
            if (row.meta_class != meta_class)
                continue;
            add(std::string("join/") + meta_class->name, row, join_all);
            add(std::string("sides/") + meta_class->name, row, read_sides);
        }
    }
    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
}
