// What the adapters of this host tell, as samples of metrics.
#pragma once

#include "cli/host.h"
#include "cli/openmetrics.h"
#include "cli/session.h"

#include <ctime>

namespace hxa::openmetrics
{

// Reads every adapter and port. What cannot be read is told by the session, has no samples and is counted in hxa_read_errors.
// `now` is the time of the read.
std::vector<Sample> read_samples(Session& session, const Host& host, std::time_t now);

} // namespace hxa::openmetrics
