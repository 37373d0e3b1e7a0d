#include "cli/commands.h"
#include "cli/counters.h"
#include "cli/field_text.h"
#include "cli/openmetrics_reading.h"
#include "cli/report.h"

#include <chrono>
#include <thread>

namespace hxa
{

namespace
{

using Clock = std::chrono::steady_clock;

constexpr Column counter_columns[] = {{"Counter", "name"}, {"Value", "value"}};
constexpr Column rate_columns[] = {
    {"Port", "port"}, {"Block", "block"}, {"Counter", "name"}, {"Value", "value"}, {"Per second", "per_second"}};

// What was read of all selected ports at one moment.
struct Reading
{
    Clock::time_point time;
    std::vector<std::vector<Counter_Block>> ports;
};

Reading read(Session& session, const std::vector<Port>& ports)
{
    Reading reading{Clock::now(), {}};
    for (const auto& port : ports)
        reading.ports.push_back(counters_of(session, port));
    return reading;
}

void show(Session& session, const std::vector<Port>& ports)
{
    List trees;
    std::string text;
    for (const auto& port : ports)
    {
        List blocks;
        for (const auto& block : counters_of(session, port))
        {
            List counters;
            for (const auto& counter : block.counters)
                counters.push_back(Object{{"name", counter.name}, {"value", counter.value}});
            text += (text.empty() ? "" : "\n") + ("Port " + port.name() + ", " + block.name) + "\n\n" +
                    table(counters, counter_columns);
            blocks.push_back(Object{{"block", block.name}, {"counters", counters}});
        }
        trees.push_back(Object{{"port", port.name()},
                               {"wwn", port.fc ? Value(wwn_text(port.fc->pwwn)) : Value()},
                               {"mac", port.ethernet ? Value(mac_text(port.ethernet->mac)) : Value()},
                               {"blocks", blocks}});
    }
    session.answer(Object{{"ports", trees}}, text);
}

const Counter_Block* find(const std::vector<Counter_Block>& blocks, const std::string& name)
{
    for (const auto& block : blocks)
        if (block.name == name)
            return &block;
    return nullptr;
}

// What went up between two readings. A counter that went down was reset, or came to its end: it has no rate.
List rates(const std::vector<Port>& ports, const Reading& before, const Reading& now)
{
    const double seconds = std::chrono::duration<double>(now.time - before.time).count();
    List rows;
    for (std::size_t port = 0; port < ports.size(); ++port)
        for (const auto& block : now.ports[port])
        {
            const auto* earlier = find(before.ports[port], block.name);
            for (std::size_t i = 0; earlier && i < block.counters.size(); ++i)
            {
                const auto& counter = block.counters[i];
                if (counter.value > earlier->counters[i].value)
                    rows.push_back(
                        Object{{"port", ports[port].name()},
                               {"block", block.name},
                               {"name", counter.name},
                               {"value", counter.value},
                               {"per_second", static_cast<double>(counter.value - earlier->counters[i].value) / seconds}});
            }
        }
    return rows;
}

void watch(Session& session, const std::vector<Port>& ports, const Stats_Options& options)
{
    const std::chrono::duration<double> pause(*options.watch);
    auto before = read(session, ports);
    for (unsigned round = 1; options.count == 0 || round <= options.count; ++round)
    {
        std::this_thread::sleep_for(pause);
        auto now = read(session, ports);
        const auto rows = rates(ports, before, now);
        session.answer_line(Object{{"rates", rows}}, (round == 1 ? "" : "\n") + table(rows, rate_columns));
        before = std::move(now);
    }
}

} // namespace

void stats(Session& session, const Stats_Options& options)
{
    const Host host(session);
    if (!options.openmetrics.empty())
    {
        const auto samples = openmetrics::read_samples(session, host, std::time(nullptr));
        openmetrics::write_file(options.openmetrics, openmetrics::text_of(samples, openmetrics::form_for(options.openmetrics)));
        return;
    }
    const auto ports = host.ports(options.port);
    if (options.reset)
    {
        session.confirm("The counters of " + std::to_string(ports.size()) + " ports are set to 0.");
        for (const auto& port : ports)
            reset_counters(port);
        return;
    }
    options.watch ? watch(session, ports, options) : show(session, ports);
}

} // namespace hxa
