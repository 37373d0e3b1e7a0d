// What metrics/families.tsv and metrics/port_states.tsv say, as constants of the program.
#pragma once

#include <array>
#include <cstdint>
#include <string_view>

namespace hxa::openmetrics
{

enum class Type
{
    counter,
    gauge,
    info
};

// A sum of the access library's counters of a port, times a factor. Without a name the port does not count it.
struct Counted
{
    std::array<std::string_view, 5> names = {};
    std::uint64_t factor = 0;
};

struct Family
{
    std::string_view name; // of its samples
    Type type;
    std::string_view unit; // empty without one
    std::array<std::string_view, 6> labels;
    std::string_view help;
    Counted of_fc;
    Counted of_fcoe;
};

// A word for some of the drivers' port states; the last one, without a number, is for all others.
struct Port_State
{
    std::string_view word;
    std::array<std::uint32_t, 2> numbers;
};

} // namespace hxa::openmetrics
