// The commands. Each reads the host, does what its options say and answers through the session; what stops it is a Failure.
#pragma once

#include "cli/session.h"

#include <optional>
#include <string>

namespace hxa
{

struct List_Options
{
    std::string adapter; // all without
    bool names = false;  // only what selects adapters and ports
};
void list(Session& session, const List_Options& options);

struct Stats_Options
{
    std::string port; // or adapter; all without
    bool reset = false;
    std::optional<double> watch; // seconds between two readings
    unsigned count = 0;          // of readings that are watched; 0: until interrupted
    std::string openmetrics;     // file to write instead
};
void stats(Session& session, const Stats_Options& options);

} // namespace hxa
