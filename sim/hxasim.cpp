#include "sim/hxasim.h"

#include "sim/simulator.h"

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

void load_text(const std::string& json) { simulator().load(parse_scenario(json)); }

void unload() { simulator().unload(); }

std::vector<Request> take_requests() { return simulator().take_requests(); }

std::uint64_t request_count() { return simulator().request_count(); }

void inject(const Fault& fault) { simulator().inject(fault); }

void clear_faults() { simulator().clear_faults(); }

std::vector<std::string> violations() { return simulator().violations(); }

int open_descriptors() { return simulator().open_descriptors(); }

} // namespace hxasim
