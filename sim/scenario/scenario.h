// A simulated host as its scenario describes it. README.md documents the JSON form key by key.
#pragma once

#include "sim/model/adapter.h"
#include "sim/model/fault.h"
#include "sim/model/node.h"

#include <array>
#include <string>
#include <vector>

namespace hxasim
{

struct Scenario
{
    std::array<Driver, 2> drivers; // by Node
    std::vector<Adapter> adapters;
    std::vector<Fault> faults;

    Driver& driver(Node node) { return drivers[static_cast<std::size_t>(node)]; }
};

// The scenario written in `json`. Throws std::runtime_error that names the place of the first error.
Scenario parse_scenario(const std::string& json);

// The JSON text of a shipped scenario ("mixed") or of a file (anything with a slash or a dot in it). Throws
// std::runtime_error when there is no such file, or it is not a regular file of at most 16 MiB.
std::string read_scenario_file(const std::string& name_or_path);

} // namespace hxasim
