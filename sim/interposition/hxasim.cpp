#include "sim/hxasim.h"

#include "sim/interposition/process.h"
#include "sim/interposition/waits.h"

#include <algorithm>

namespace hxasim
{

void load(const std::string& name_or_path)
{
    auto text = read_scenario_file(name_or_path);
    try
    {
        load_text(text);
    }
    catch (const std::runtime_error& error)
    {
        throw std::runtime_error(name_or_path + ": " + error.what());
    }
}

void load_text(const std::string& json)
{
    simulator().load(parse_scenario(json));
    take_slept(); // before this host
}

void unload() { simulator().unload(); }

std::vector<Request> take_requests() { return simulator().take_requests(); }

std::uint64_t request_count() { return simulator().request_count(); }

void inject(const Fault& fault) { simulator().inject(fault); }

Fault fault_at(const std::vector<Request>& requests, std::size_t index)
{
    const auto& chosen = requests.at(index);
    const auto same = [&](const Request& request) { return request.name == chosen.name && request.node == chosen.node; };
    const auto before = std::count_if(requests.begin(), requests.begin() + static_cast<std::ptrdiff_t>(index), same);
    return {.command = chosen.name, .node = chosen.node, .skip = static_cast<int>(before), .times = 1};
}

void clear_faults() { simulator().clear_faults(); }

std::vector<std::string> violations() { return simulator().violations(); }

int open_descriptors() { return simulator().open_descriptors(); }

void raise_event(const Event& event) { simulator().raise_event(event); }

std::uint64_t lost_events(std::uint32_t application) { return simulator().lost_events(application); }

void unplug(std::size_t adapter) { simulator().plug(adapter, false); }

void plug(std::size_t adapter) { simulator().plug(adapter, true); }

void set_link(std::size_t adapter, std::size_t port, bool up) { simulator().link(adapter, port, up); }

void set_sfp(std::size_t adapter, std::size_t port, bool inserted) { simulator().sfp(adapter, port, inserted); }

void serve_control(const std::string& path) { serve_control_at(path); }

} // namespace hxasim
