#include "indications/severity.h"

#include "hxal/hxal.h"
#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "IndicationHelper";

} // namespace

Perceived_Severity getPerceivedSeverity(int severity)
{
    const Scope_Trace trace(log_source);
    switch (severity)
    {
    case HXA_LOG_CRITICAL:
    case HXA_LOG_ERROR:
        return SEVERITY_CRITICAL;
    case HXA_LOG_WARNING:
        return SEVERITY_WARNING;
    case HXA_LOG_INFO:
        return SEVERITY_INFORMATION;
    default:
        ZMLR_LOG(LL_WARN, "Received a un-expected severity value: %d", severity);
        return SEVERITY_UNKNOWN;
    }
}

} // namespace zmlr
