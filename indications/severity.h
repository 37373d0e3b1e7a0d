// How grave an event is.
#pragma once

#include "runtime/types.h"

namespace zmlr
{

// CIM_AlertIndication.PerceivedSeverity
enum Perceived_Severity : uint16
{
    SEVERITY_UNKNOWN = 0,
    SEVERITY_INFORMATION = 2,
    SEVERITY_WARNING = 3,
    SEVERITY_CRITICAL = 6
};

// The severity that stands for one of the access library (hxa_log_severity_t); 0 for what is none.
Perceived_Severity getPerceivedSeverity(int severity);

} // namespace zmlr
